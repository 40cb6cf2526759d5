// Generates the completion script for bash from the option and command tables.

#include "CompletedWords.h"
#include "Completion.h"

namespace gw {

namespace {

// The fixed part of every script; the generated part is what _gaitwright selects from. Words and file names
// are never expanded or executed. COMP_WORDS contains words as typed, including backslashes and quotes.
constexpr std::string_view kFunctions =
    R"bash(# bash completion for gaitwright, written by 'gaitwright --completion bash'

_gaitwright_words() {
    local candidate
    for candidate; do
        [[ $candidate == "$word"* ]] && COMPREPLY+=("$candidate")
    done
}

# Folders, and the files with one of the extensions; without any, all files.
_gaitwright_files() {
    local path extension
    compopt -o filenames 2>/dev/null
    while IFS= read -r path; do
        extension=${path##*.}
        if [[ -d $path || $# -eq 0 || " $* " == *" ${extension,,} "* ]]; then
            COMPREPLY+=("$path")
        fi
    done < <(compgen -f -- "$word")
}

_gaitwright_folders() {
    compopt -o filenames 2>/dev/null
    mapfile -t COMPREPLY < <(compgen -d -- "$word")
}

_gaitwright_profiles() {
    local names
    _gaitwright_files "$@"
    mapfile -t names < <("${COMP_WORDS[0]}" profiles 2>/dev/null | sed -E 's/ \((stock|own), .*//')
    _gaitwright_words "${names[@]}"
}

_gaitwright() {
    local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]} options=
    COMPREPLY=()
    if [[ $word == = ]]; then
        word=
    elif [[ $before == = ]]; then
        before=${COMP_WORDS[COMP_CWORD - 2]}
    fi
    word=${word//\\/}
    word=${word#[\"\']}
)bash";

std::string OfferCall(const CompletedWord& word)
{
    const std::string words = word.words.empty() ? std::string() : ' ' + Joined(word.words, " ");
    switch (word.offer)
    {
    case EOffer::Choices:
        return "_gaitwright_words" + words;
    case EOffer::Files:
        return "_gaitwright_files" + words;
    case EOffer::Folders:
        return "_gaitwright_folders";
    case EOffer::Profiles:
        return "_gaitwright_profiles" + words;
    default:
        return ":";
    }
}

std::string ValueCases()
{
    std::string text;
    for (const OptionRow& row : OptionTable())
    {
        const CompletedWord value = ValueOf(row);
        if (value.offer != EOffer::Nothing)
            text += "    " + Joined(Parts(row.names, ","), " | ") + ") " + OfferCall(value) + "; return ;;\n";
    }
    return text;
}

std::string OptionWords(const ShellCommand& command)
{
    std::string text;
    for (const OptionRow& row : OptionTable())
        text += HasOption(command, row) ? Joined(Parts(row.names, ","), " ") + ' ' : std::string();
    return text + "-h --help";
}

std::string CommandCases()
{
    std::string text;
    for (const ShellCommand& command : Commands())
        text += "    " + std::string(command.name) + ")\n        options='" + OptionWords(command) +
                "'\n        [[ $word == -* ]] || " + OfferCall(AnyOperandOf(command)) + "\n        ;;\n";
    return text;
}

std::string CommandWords()
{
    std::string text;
    for (const ShellCommand& command : Commands())
        text += std::string(command.name) + ' ';
    return text;
}

} // namespace

std::string BashCompletion()
{
    return std::string(kFunctions) + "    if ((COMP_CWORD == 1)); then\n        _gaitwright_words " +
           CommandWords() + "-h --help --version\n        return\n    fi\n    case $before in\n" +
           ValueCases() + "    esac\n    case ${COMP_WORDS[1]} in\n" + CommandCases() +
           "    esac\n    # shellcheck disable=SC2086\n    [[ $word != -* ]] || _gaitwright_words "
           "$options\n}\n\ncomplete -F _gaitwright gaitwright\n";
}

} // namespace gw
