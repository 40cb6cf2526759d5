#include "Arguments.h"

#include "Numbers.h"
#include "OptionTable.h"
#include "Text.h"
#include "Words.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <optional>

namespace gw {

namespace {

struct OptionBinder
{
    CLI::App& app;
    const COptionRow& row;
    COptions& options;

    CLI::Option* operator()(bool COptions::*target) const
    {
        return app.add_flag(std::string(row.names), options.*target);
    }
    CLI::Option* operator()(std::string COptions::*target) const
    {
        return app.add_option(std::string(row.names), options.*target);
    }
    CLI::Option* operator()(int64_t COptions::*target) const
    {
        return app.add_option(std::string(row.names), options.*target);
    }
    // Read by the project's own parser, which knows no locale.
    CLI::Option* operator()(float COptions::*target) const
    {
        const auto take = [value = &(options.*target)](const std::string& text) {
            ENumber kind = ENumber::None;
            const float number = static_cast<float>(ParseDouble(text, kind));
            if (kind != ENumber::Whole || !(number > 0.0f) || !std::isfinite(number))
                throw CLI::ValidationError(Quoted(text) + " is no number above 0");
            *value = number;
        };
        return app.add_option_function<std::string>(std::string(row.names), take);
    }
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
        return Quoted(text) + " is none of " + std::string(choices);
    };
    return CLI::Validator(check, std::string(choices));
}

void AddOptions(CLI::App& app, const CCommand& command, COptions& options)
{
    for (const COptionRow& row : OptionTable())
    {
        if (!(OptionsOf(command) & row.bit))
            continue;
        CLI::Option* option = std::visit(OptionBinder{app, row, options}, row.target);
        option->required((command.required & row.bit) != 0);
        if (!row.choices.empty())
            option->check(OneOf(row.choices));
    }
    app.add_option("files", options.files);
    app.allow_extras();
}

// All forms of the options that a command takes: "-o", "--output", ...
std::vector<std::string> OptionNames(const CCommand& command)
{
    std::vector<std::string> names{"--help"};
    for (const COptionRow& row : OptionTable())
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
    SayError(remedy);
    return EExit::Usage;
}

EExit RefuseFor(const CCommand& command, std::string_view words, std::string_view nearest = {})
{
    return Refuse(words, nearest, "usage: " + UsageLine(command));
}

// An option that the command does not have; with "=value" behind it or not.
EExit RefuseUnknown(const CCommand& command, const std::string& argument)
{
    const std::string name = argument.substr(0, argument.find('='));
    const std::string words = std::string(command.name) + " has no option " + Quoted(name);
    return RefuseFor(command, words, NearestName(name, OptionNames(command)));
}

std::vector<std::string> CommandNames()
{
    std::vector<std::string> names;
    for (const CCommand& command : Commands())
        names.emplace_back(command.name);
    return names;
}

EExit Print(const std::string& text)
{
    std::fputs(text.c_str(), stdout);
    return EExit::Done;
}

// Nothing where the command may run. A wrong option is told before what is missing.
std::optional<EExit> ParseFor(const CCommand& command, int argc, char** argv, COptions& options)
{
    CLI::App app;
    AddOptions(app, command, options);
    std::string wrong;
    try
    {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp&)
    {
        return Print(CommandHelp(command));
    } catch (const CLI::ParseError& error)
    {
        wrong = error.what();
    }
    const std::vector<std::string> unknown = app.remaining();
    if (!unknown.empty())
        return RefuseUnknown(command, unknown.front());
    if (!wrong.empty())
        return RefuseFor(command, Printable(wrong));
    if (options.files.size() < command.leastOperands)
        return RefuseFor(command, std::string(command.name) + " needs " + std::string(command.operands));
    if (options.files.size() > command.mostOperands)
        return RefuseFor(command, "one argument too many: " + Quoted(options.files[command.mostOperands]));
    return std::nullopt;
}

EExit ParseWithoutCommand(std::string_view word)
{
    if (word == "--help" || word == "-h")
        return Print(ProgramHelp());
    if (word == "--version")
        return Print("gaitwright " GAITWRIGHT_VERSION "\n");
    const std::string remedy = "'gaitwright --help' lists the commands";
    if (word.empty())
        return Refuse("a command is missing", {}, remedy);
    return Refuse("there is no command " + Quoted(word), NearestName(word, CommandNames()), remedy);
}

} // namespace

CArguments ParseArguments(int argc, char** argv)
{
    CArguments arguments;
    const std::string_view word = argc > 1 ? argv[1] : "";
    const auto command = std::ranges::find(Commands(), word, &CCommand::name);
    if (command == Commands().end())
    {
        arguments.exit = ParseWithoutCommand(word);
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
