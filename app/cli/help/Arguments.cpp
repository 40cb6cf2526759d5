// Builds the parser from the option and command tables, so that help, completion and parsing never differ.
// Numbers are parsed by our own functions, which ignore the locale and reject trailing characters.

#include "Arguments.h"

#include "Completion.h"
#include "ManPage.h"
#include "Numbers.h"
#include "OptionTable.h"
#include "Paths.h"
#include "Streams.h"
#include "Text.h"
#include "Words.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <functional>
#include <optional>
#include <span>

namespace gw {

namespace {

// Returns false unless the text is a number that fits into the integer.
template <class T>
bool ScanInteger(std::string_view text, T& number)
{
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && end == text.data() + text.size();
}

// Same for a number that fits into 32 bits.
bool ScanNumber(std::string_view text, float& number)
{
    ENumber kind = ENumber::None;
    number = static_cast<float>(ParseDouble(text, kind));
    return kind == ENumber::Whole && std::isfinite(number);
}

// Returns "--output" of "-o,--output".
std::string LongName(const OptionRow& row)
{
    return std::string(row.names.substr(row.names.rfind(',') + 1));
}

[[noreturn]] void RefuseValue(const OptionRow& row, const std::string& text, const char* words)
{
    throw CLI::ValidationError(LongName(row) + ": " + Quoted(text) + ' ' + words);
}

// Registers an option with the parser, according to the type of its value.
class OptionBinder
{
public:
    OptionBinder(CLI::App& app, const OptionRow& row, ShellOptions& options)
        : app_(app), row_(row), options_(options)
    {
    }

    CLI::Option* operator()(bool ShellOptions::*target) const
    {
        return app_.add_flag(std::string(row_.names), options_.*target);
    }
    CLI::Option* operator()(std::string ShellOptions::*target) const
    {
        return app_.add_option(std::string(row_.names), options_.*target);
    }
    CLI::Option* operator()(int64_t ShellOptions::*target) const
    {
        return Add([&row = row_, number = &(options_.*target)](const std::string& text) {
            if (!ScanInteger(text, *number) || *number < 0)
                RefuseValue(row, text, "is not a whole number, 0 or more");
        });
    }
    CLI::Option* operator()(std::optional<int64_t> ShellOptions::*target) const
    {
        return Add([&row = row_, number = &(options_.*target)](const std::string& text) {
            if (!ScanInteger(text, number->emplace()) || **number < 0)
                RefuseValue(row, text, "is not a count");
        });
    }
    CLI::Option* operator()(PixelSize ShellOptions::*target) const
    {
        return Add([&row = row_, size = &(options_.*target)](const std::string& text) {
            const std::string_view words = text;
            const size_t cross = std::min(text.find('x'), text.size());
            if (!ScanInteger(words.substr(0, cross), size->width) ||
                !ScanInteger(words.substr(std::min(cross + 1, text.size())), size->height))
                RefuseValue(row, text, "is not a size such as 640x480");
        });
    }
    CLI::Option* operator()(float ShellOptions::*target) const
    {
        return Add([&row = row_, number = &(options_.*target)](const std::string& text) {
            if (!ScanNumber(text, *number) || !(*number > 0.0f))
                RefuseValue(row, text, "is not a positive number");
        });
    }
    CLI::Option* operator()(std::optional<float> ShellOptions::*target) const
    {
        return Add([&row = row_, number = &(options_.*target)](const std::string& text) {
            if (!ScanNumber(text, number->emplace()))
                RefuseValue(row, text, "is not a number");
        });
    }

private:
    // Numbers are parsed by our own functions, which ignore the locale and reject anything that is not a
    // number.
    CLI::Option* Add(const std::function<void(const std::string&)>& take) const
    {
        return app_.add_option_function<std::string>(std::string(row_.names), take);
    }

    CLI::App& app_;
    const OptionRow& row_;
    ShellOptions& options_;
};

CLI::Validator OneOf(std::string_view choices)
{
    const auto check = [choices](std::string& text) {
        std::string_view rest = choices;
        for (std::string_view word = NextToken(rest, "|"); !word.empty(); word = NextToken(rest, "|"))
        {
            if (word == text)
                return std::string();
        }
        return Quoted(text) + " is not one of " + std::string(choices);
    };
    return CLI::Validator(check, std::string(choices));
}

CLI::Validator FrameRange()
{
    const auto check = [](std::string& text) {
        int64_t first = 0;
        int64_t last = 0;
        return ReadFrames(text, first, last) ? std::string()
                                             : Quoted(text) + " is not a range of frames such as 10-50";
    };
    return CLI::Validator(check, "A-B");
}

// Returns whether any argument can refer to an option. Short names can be joined, as in "-fq".
bool MayBeGiven(const OptionRow& row, std::span<char* const> arguments)
{
    std::string_view rest = row.names;
    for (std::string_view name = NextToken(rest); !name.empty(); name = NextToken(rest))
    {
        const auto refers = [=](std::string_view argument) {
            return name.starts_with("--")
                       ? argument.starts_with(name)
                       : argument.starts_with('-') && argument.find(name.back()) != argument.npos;
        };
        if (std::ranges::any_of(arguments, refers))
            return true;
    }
    return false;
}

// Registers a command's options, except those that make no difference because no argument refers to them: the
// parser compares each new option with all others, which takes a twentieth of a small conversion.
void AddOptions(CLI::App& app, const ShellCommand& command, std::span<char* const> arguments,
                ShellOptions& options)
{
    const uint64_t always = command.required | command.choice;
    for (const OptionRow& row : OptionTable())
    {
        if (!(OptionsOf(command) & row.bit) || !(always & row.bit || MayBeGiven(row, arguments)))
            continue;
        CLI::Option* option = std::visit(OptionBinder(app, row, options), row.target);
        option->required((command.required & row.bit) != 0);
        if (!row.choices.empty())
            option->check(OneOf(row.choices));
        if (row.bit == kFrames)
            option->check(FrameRange());
    }
    app.add_option("files", options.files);
    app.allow_extras();
    app.allow_windows_style_options(false); // a word that begins with a slash is a path everywhere
}

// Counts how many of the options of an exclusive choice a command line has.
size_t CountChosen(const CLI::App& app, const ShellCommand& command)
{
    size_t chosen = 0;
    for (const OptionRow& row : OptionTable())
        chosen +=
            command.choice & row.bit && app.count(std::string(row.names.substr(0, row.names.find(',')))) > 0
                ? 1
                : 0;
    return chosen;
}

// Returns all forms of a command's options: "-o", "--output", ...
std::vector<std::string> OptionNames(const ShellCommand& command)
{
    std::vector<std::string> names{"--help"};
    for (const OptionRow& row : OptionTable())
    {
        std::string_view rest = OptionsOf(command) & row.bit ? row.names : std::string_view();
        for (std::string_view name = NextToken(rest); !name.empty(); name = NextToken(rest))
            names.emplace_back(name);
    }
    return names;
}

EExit Refuse(std::string_view words, std::string_view nearest, const std::string& remedy)
{
    const std::string guess = nearest.empty() ? "" : "; did you mean '" + std::string(nearest) + "'?";
    SayError(std::string(words) + guess);
    SayPlain(remedy);
    return EExit::Usage;
}

EExit RefuseFor(const ShellCommand& command, std::string_view words, std::string_view nearest = {})
{
    return Refuse(words, nearest, "usage: " + UsageLine(command));
}

// Reports an option that the command does not have, with or without "=value".
EExit RefuseUnknown(const ShellCommand& command, const std::string& argument)
{
    const std::string name = argument.substr(0, argument.find('='));
    const std::string words = std::string(command.name) + " has no option " + Quoted(name);
    return RefuseFor(command, words, NearestName(name, OptionNames(command)));
}

std::vector<std::string> CommandNames()
{
    std::vector<std::string> names;
    for (const ShellCommand& command : Commands())
        names.emplace_back(command.name);
    return names;
}

EExit Print(const std::string& text)
{
    std::fputs(text.c_str(), stdout);
    return EExit::Done;
}

// The extension of a result that goes into a folder. 'convert' and 'extract' find it themselves.
struct FolderRow
{
    std::string_view command;
    std::string_view extension;
};
constexpr FolderRow kFolderRows[] = {
    {"align",   ".bvh"    },
    {"doctor",  ".bvh"    },
    {"dump",    ".html"   },
    {"package", ".Kinetra"},
    {"render",  ".png"    },
    {"suggest", ".prf"    },
};

void NameInFolder(const ShellCommand& command, ShellOptions& options)
{
    const auto row = std::ranges::find(kFolderRows, command.name, &FolderRow::command);
    std::string extension = row == std::end(kFolderRows) ? std::string() : std::string(row->extension);
    if (command.name == "resave")
        extension = SplitPath(options.files[0]).extension;
    if (command.name == "transcode" && !options.format.empty())
        extension = '.' + options.format;
    if (extension.empty())
        return;
    for (std::string* output : {&options.output, &options.animate, &options.fix})
        *output = InFolder(*output, options.files[0], extension);
    if (command.operands == "IN OUT")
        options.files[1] = InFolder(options.files[1], options.files[0], extension);
}

// Returns nothing if the command can run. Unknown options are reported before missing ones.
std::optional<EExit> ParseFor(const ShellCommand& command, int argc, char** argv, ShellOptions& options)
{
    CLI::App app;
    AddOptions(app, command, std::span(argv, static_cast<size_t>(argc)), options);
    std::string wrong;
    try
    {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp&)
    {
        return Print(CommandHelp(command));
    } catch (const CLI::ArgumentMismatch& error)
    {
        wrong = error.what();
        wrong = wrong.substr(0, wrong.find(':')) + ": a value is missing";
    } catch (const CLI::ParseError& error)
    {
        wrong = error.what();
    }
    const std::vector<std::string> unknown = app.remaining();
    const auto option = std::ranges::find_if(unknown, [](const std::string& word) { return word != "--"; });
    if (option != unknown.end())
        return RefuseUnknown(command, *option);
    if (!wrong.empty())
        return RefuseFor(command, Printable(wrong));
    if (command.choice && CountChosen(app, command) != 1)
        return RefuseFor(command, std::string(command.name) + " needs one of " + ChoiceText(command));
    if (options.files.size() < LeastOperands(command) && options.filesFrom.empty())
        return RefuseFor(command, std::string(command.name) + " needs " + std::string(command.operands));
    if (options.files.size() > MostOperands(command))
        return RefuseFor(command, "unexpected argument: " + Quoted(options.files[MostOperands(command)]));
    if (options.rate > 0.0f && !std::isfinite(1.0f / options.rate))
        return RefuseFor(command, "--rate: the number is too small for a rate");
    const std::string& output = options.output.empty() ? options.fix : options.output;
    if (options.json && IsStandardOutput(output))
        return RefuseFor(command, "--json and the result would both go to standard output");
    options.draft = options.draft || !options.drafts.empty();
    NameInFolder(command, options);
    return std::nullopt;
}

std::string Version()
{
    return "gaitwright " GAITWRIGHT_VERSION "\n";
}

// Options that print information about the program instead of running a command. The last ones are for
// packagers.
struct SelfRow
{
    std::string_view words;
    std::string (*text)();
};
constexpr SelfRow kSelf[] = {
    {"--help",            ProgramHelp   },
    {"-h",                ProgramHelp   },
    {"--version",         Version       },
    {"--man-page",        ManPage       },
    {"--completion bash", BashCompletion},
    {"--completion fish", FishCompletion},
    {"--completion zsh",  ZshCompletion },
};

EExit ParseWithoutCommand(std::string_view word, std::string_view next)
{
    const std::string both = std::string(word) + ' ' + std::string(next);
    for (const SelfRow& row : kSelf)
    {
        if (row.words == word || row.words == both)
            return Print(row.text());
    }
    const std::string remedy = "'gaitwright --help' lists the commands";
    const bool isHelp = word == "help";
    if (isHelp && next.empty())
        return Print(ProgramHelp());
    if (const auto command = std::ranges::find(Commands(), next, &ShellCommand::name);
        isHelp && command != Commands().end())
        return Print(CommandHelp(*command));
    if (isHelp)
        return Refuse("unknown command " + Quoted(next), NearestName(next, CommandNames()), remedy);
    if (word.empty())
        return Refuse("missing command", {}, remedy);
    return Refuse("unknown command " + Quoted(word), NearestName(word, CommandNames()), remedy);
}

} // namespace

bool ReadFrames(std::string_view text, int64_t& first, int64_t& last)
{
    const size_t dash = std::min(text.find('-'), text.size());
    if (!ScanInteger(text.substr(0, dash), first))
        return false;
    last = first;
    return dash == text.size() || (ScanInteger(text.substr(dash + 1), last) && first <= last);
}

Arguments ParseArguments(int argc, char** argv)
{
    Arguments arguments;
    const std::string_view word = argc > 1 ? argv[1] : "";
    const auto command = std::ranges::find(Commands(), word, &ShellCommand::name);
    if (command == Commands().end())
    {
        arguments.exit = ParseWithoutCommand(word, argc > 2 ? argv[2] : "");
        return arguments;
    }
    const std::optional<EExit> end = ParseFor(*command, argc - 1, argv + 1, arguments.options);
    if (end)
        arguments.exit = *end;
    else
        arguments.command = &*command;
    return arguments;
}

} // namespace gw
