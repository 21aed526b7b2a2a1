// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Manual page and completions: both traverse the same list of commands.
#include "Manual.h"

#include <functional>
#include <vector>

namespace tool {
namespace {

struct OptionFacts {
    std::vector<std::string> names; ///< "--json", "-h"; empty for positional arguments
    std::string value;              ///< its argument: "N"; the name of a positional argument
    std::string help;
    bool repeated = false;
};

struct CommandFacts {
    std::string name, help;
    std::vector<OptionFacts> options, positionals;
};

OptionFacts factsOf(const CLI::Option& option) {
    OptionFacts facts;
    for (const std::string& name : option.get_lnames())
        facts.names.push_back("--" + name);
    for (const std::string& name : option.get_snames())
        facts.names.push_back("-" + name);
    facts.help = option.get_description();
    facts.repeated = option.get_expected_max() > 1;
    if (facts.names.empty())
        facts.value = option.get_name(/*positional=*/true);
    else if (option.get_expected_max() > 0)
        facts.value = option.get_type_name();
    return facts;
}

std::vector<CommandFacts> commandsOf(const CLI::App& app) {
    std::vector<CommandFacts> commands;
    for (const CLI::App* command :
         app.get_subcommands([](const CLI::App* each) { return !each->get_group().empty(); })) {
        CommandFacts facts{command->get_name(), command->get_description(), {}, {}};
        for (const CLI::Option* option : command->get_options()) {
            OptionFacts each = factsOf(*option);
            (each.names.empty() ? facts.positionals : facts.options).push_back(std::move(each));
        }
        commands.push_back(std::move(facts));
    }
    return commands;
}

std::string joined(const std::vector<std::string>& words, const char* between) {
    std::string text;
    for (const std::string& word : words)
        text += (text.empty() ? "" : between) + word;
    return text;
}

/// Escapes characters with a meaning in a language.
std::string escaped(const std::string& text, const std::function<std::string(char)>& escape) {
    std::string result;
    for (const char character : text)
        result += escape(character);
    return result;
}

// ---- The manual page ----

std::string roff(const std::string& text) {
    return escaped(
        text,
        [](char character) -> std::string {
            switch (character) {
            case '\\':
                return "\\e";
            case '-':
                return "\\-";
            case '\'':
                return "\\(aq";
            default:
                return std::string(1, character);
            }
        });
}

void writeOption(const OptionFacts& option, std::ostream& out) {
    out << ".TP\n";
    if (option.names.empty()) {
        out << ".I " << roff(option.value) << (option.repeated ? " .\\|.\\|." : "") << '\n';
    } else {
        out << ".B " << roff(joined(option.names, ", "));
        out << (option.value.empty() ? "" : " \\fI" + roff(option.value) + "\\fR") << '\n';
    }
    out << roff(option.help) << ".\n";
}

void writeSynopsis(const CommandFacts& command, std::ostream& out) {
    out << ".B tarnell\\-fbx " << roff(command.name) << "\n[\\fIoptions\\fR]";
    for (const OptionFacts& positional : command.positionals)
        out << " \\fI" << roff(positional.value) << "\\fR" << (positional.repeated ? " .\\|.\\|." : "");
    out << "\n.br\n";
}

// ---- Completions ----

std::vector<std::string> namesOf(const std::vector<CommandFacts>& commands) {
    std::vector<std::string> names;
    names.reserve(commands.size() + 1);
    for (const CommandFacts& command : commands)
        names.push_back(command.name);
    names.emplace_back("help");
    return names;
}

void writeBash(const std::vector<CommandFacts>& commands, std::ostream& out) {
    out << "# bash completion of tarnell-fbx\n"
           "_tarnell_fbx() {\n"
           "    local current=${COMP_WORDS[COMP_CWORD]} words=\n"
           "    COMPREPLY=()\n"
           "    if ((COMP_CWORD == 1)) || [[ ${COMP_WORDS[1]} == help ]]; then\n"
           "        words='"
        << joined(namesOf(commands), " ")
        << " --help --version'\n"
           "    elif [[ $current == -* ]]; then\n"
           "        case ${COMP_WORDS[1]} in\n";
    for (const CommandFacts& command : commands) {
        std::vector<std::string> names;
        for (const OptionFacts& option : command.options)
            names.insert(names.end(), option.names.begin(), option.names.end());
        out << "        " << command.name << ") words='" << joined(names, " ") << "' ;;\n";
    }
    out << "        esac\n"
           "    else\n"
           "        compopt -o filenames 2>/dev/null\n"
           "        mapfile -t COMPREPLY < <(compgen -f -- \"$current\")\n"
           "        return\n"
           "    fi\n"
           "    mapfile -t COMPREPLY < <(compgen -W \"$words\" -- \"$current\")\n"
           "}\n"
           "complete -F _tarnell_fbx tarnell-fbx\n";
}

std::string zshQuoted(const std::string& text) {
    return escaped(
        text,
        [](char character) -> std::string {
            if (character == '\'')
                return "'\\''";
            return character == '[' || character == ']' || character == ':' ? std::string("\\") + character
                                                                            : std::string(1, character);
        });
}

void writeZsh(const std::vector<CommandFacts>& commands, std::ostream& out) {
    out << "#compdef tarnell-fbx\n"
           "_tarnell_fbx() {\n"
           "    local -a commands\n"
           "    commands=(\n";
    for (const CommandFacts& command : commands)
        out << "        '" << command.name << ':' << zshQuoted(command.help) << "'\n";
    out << "        'help:Show the help of a command'\n"
           "    )\n"
           "    if ((CURRENT == 2)) || [[ $words[2] == help ]]; then\n"
           "        _describe command commands\n"
           "        return\n"
           "    fi\n"
           "    local command=$words[2]\n"
           "    shift words\n"
           "    ((CURRENT--))\n"
           "    case $command in\n";
    for (const CommandFacts& command : commands) {
        out << "    " << command.name << ")\n        _arguments";
        for (const OptionFacts& option : command.options) {
            for (const std::string& name : option.names)
                out << " \\\n            '" << name << '[' << zshQuoted(option.help) << ']'
                    << (option.value.empty() ? "" : ":" + zshQuoted(option.value) + ":") << '\'';
        }
        out << " \\\n            '*:file:_files' ;;\n";
    }
    out << "    esac\n"
           "}\n"
           "_tarnell_fbx \"$@\"\n";
}

std::string fishQuoted(const std::string& text) {
    return '\'' +
           escaped(
               text,
               [](char character) -> std::string {
                   return character == '\'' || character == '\\' ? std::string("\\") + character
                                                                 : std::string(1, character);
               }) +
           '\'';
}

void writeFish(const std::vector<CommandFacts>& commands, std::ostream& out) {
    out << "# fish completion of tarnell-fbx\n";
    for (const CommandFacts& command : commands)
        out << "complete -c tarnell-fbx -f -n __fish_use_subcommand -a " << command.name << " -d "
            << fishQuoted(command.help) << '\n';
    out << "complete -c tarnell-fbx -f -n __fish_use_subcommand -a help -d 'Show the help of a command'\n"
           "complete -c tarnell-fbx -f -n '__fish_seen_subcommand_from help' -a "
        << fishQuoted(joined(namesOf(commands), " ")) << '\n';
    for (const CommandFacts& command : commands) {
        for (const OptionFacts& option : command.options) {
            out << "complete -c tarnell-fbx -n '__fish_seen_subcommand_from " << command.name << '\'';
            for (const std::string& name : option.names)
                out << (name.rfind("--", 0) == 0 ? " -l " + name.substr(2) : " -s " + name.substr(1));
            out << (option.value.empty() ? "" : " -x") << " -d " << fishQuoted(option.help) << '\n';
        }
    }
}

} // namespace

void writeManual(const CLI::App& app, std::ostream& out) {
    const std::vector<CommandFacts> commands = commandsOf(app);
    out << ".TH TARNELL\\-FBX 1 \"\" \"Tarnell FBX " << TARNELL_FBX_VERSION << "\"\n.SH NAME\ntarnell\\-fbx \\- "
        << roff(app.get_description()) << "\n.SH SYNOPSIS\n";
    for (const CommandFacts& command : commands)
        writeSynopsis(command, out);
    out << ".B tarnell\\-fbx help\n[\\fICOMMAND\\fR]\n.br\n.B tarnell\\-fbx \\-\\-version\n.SH COMMANDS\n";
    for (const CommandFacts& command : commands) {
        out << ".SS " << roff(command.name) << '\n' << roff(command.help) << ".\n";
        for (const OptionFacts& positional : command.positionals)
            writeOption(positional, out);
        for (const OptionFacts& option : command.options)
            writeOption(option, out);
    }
    out << ".SH \"EXIT STATUS\"\n" << roff(app.get_footer()) << '\n';
    out << ".SH ENVIRONMENT\n.TP\n.B NO_COLOR\nDisables colours on terminals.\n.TP\n.B COLUMNS\nWidth of the output, "
           "instead of that of the terminal.\n";
}

bool writeCompletion(const CLI::App& app, const std::string& shell, std::ostream& out) {
    constexpr struct {
        const char* name;
        void (*write)(const std::vector<CommandFacts>&, std::ostream&);
    } kShells[] = {{"bash", writeBash}, {"zsh", writeZsh}, {"fish", writeFish}};
    for (const auto& each : kShells) {
        if (shell == each.name) {
            each.write(commandsOf(app), out);
            return true;
        }
    }
    return false;
}

} // namespace tool
