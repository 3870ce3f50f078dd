#include "CommandLine.h"

#include <array>
#include <cerrno>
#include <cstdlib>
#include <map>

#include "TagTypes.h"
#include "TimeText.h"

namespace kvtag {
namespace {

struct CommandEntry {
    Command command;
    const char* name;
};

constexpr std::array<CommandEntry, 10> kCommands = {{{Command::Help, "help"},
                                                     {Command::List, "list"},
                                                     {Command::Read, "read"},
                                                     {Command::Write, "write"},
                                                     {Command::Create, "create"},
                                                     {Command::Keywords, "keywords"},
                                                     {Command::Properties, "properties"},
                                                     {Command::Aggregates, "aggregates"},
                                                     {Command::Delete, "delete"},
                                                     {Command::Serve, "serve"}}};

// An option as written: its name without the dashes and its value, if any.
struct RawOption {
    std::string name;
    std::optional<std::string> value;
};

bool TakesValue(const std::string& name) {
    return name == "config" || name == "timeout" || name == "skip" || name == "take" ||
           name == "keyword" || name == "property" || name == "type" || name == "time" ||
           name == "collect" || name == "listen" || name == "instance";
}

bool IsGlobal(const std::string& name) {
    return name == "config" || name == "timeout" || name == "json" || name == "verbose" ||
           name == "help";
}

bool Allowed(Command command, const std::string& name) {
    if (IsGlobal(name)) return true;
    switch (command) {
        case Command::List:
            return name == "skip" || name == "take" || name == "keyword" || name == "property";
        case Command::Write:
            return name == "type" || name == "time" || name == "stdin";
        case Command::Create:
            return name == "type";
        case Command::Keywords:
        case Command::Properties:
            return name == "set";
        case Command::Aggregates:
            return name == "collect" || name == "reset";
        case Command::Serve:
            return name == "listen" || name == "instance" || name == "allow-write";
        default:
            return false;
    }
}

uint32_t ParseCount(const std::string& option, const std::string& text, Command command) {
    const auto value = ParseUint32(text);
    if (!value) {
        throw UsageError(
            "--" + option + " needs a whole number from 0 to 4294967295, not '" + text + "'",
            command);
    }
    return *value;
}

std::pair<std::string, std::string> ParseProperty(const std::string& text, Command command) {
    const auto equals = text.find('=');
    if (equals == std::string::npos || equals == 0) {
        throw UsageError("a property is KEY=VALUE with a non-empty key, not '" + text + "'",
                         command);
    }
    return {text.substr(0, equals), text.substr(equals + 1)};
}

// HOST:PORT, with an IPv6 host in brackets ([::1]:8080); the port 0..65535.
void ParseListen(Invocation& call, const std::string& text) {
    const auto colon = text.rfind(':');
    std::string host = colon == std::string::npos ? "" : text.substr(0, colon);
    const std::string port = colon == std::string::npos ? "" : text.substr(colon + 1);
    if (host.size() > 2 && host.front() == '[' && host.back() == ']') {
        host = host.substr(1, host.size() - 2);
    }
    const auto number = ParseUint32(port);
    if (host.empty() || port.size() > 5 || !number || *number > 65535) {
        throw UsageError(
            "--listen needs HOST:PORT with a port from 0 to 65535, such as "
            "127.0.0.1:8080, not '" +
                text + "'",
            call.command);
    }
    call.listenHost = host;
    call.listenPort = static_cast<uint16_t>(*number);
}

void RequirePath(const std::string& path, Command command) {
    if (const auto problem = TagPathProblem(path)) throw UsageError(*problem, command);
}

void RequireCount(const std::vector<std::string>& words, std::size_t count, Command command,
                  const char* what) {
    if (words.size() != count) {
        throw UsageError(std::string(CommandName(command)) + " takes " + what, command);
    }
}

// Applies one option to the invocation.
void Apply(Invocation& call, const RawOption& option, bool& help) {
    const std::string& name = option.name;
    const std::string value = option.value.value_or("");
    const Command command = call.command;
    auto once = [&](bool alreadySet) {
        if (alreadySet) throw UsageError("--" + name + " given twice", command);
    };
    if (name == "help") {
        help = true;
    } else if (name == "json") {
        call.global.json = true;
    } else if (name == "verbose") {
        call.global.verbose = true;
    } else if (name == "config") {
        once(call.global.config.has_value());
        if (value.empty()) throw UsageError("--config needs a configuration id", command);
        call.global.config = value;
    } else if (name == "timeout") {
        once(call.global.timeoutMs.has_value());
        call.global.timeoutMs = ParseCount(name, value, command);
    } else if (name == "skip") {
        call.skip = ParseCount(name, value, command);
    } else if (name == "take") {
        call.take = ParseCount(name, value, command);
    } else if (name == "keyword") {
        if (value.empty()) throw UsageError("--keyword needs a non-empty keyword", command);
        call.keywords.push_back(value);
    } else if (name == "property") {
        call.properties.push_back(ParseProperty(value, command));
    } else if (name == "type") {
        once(call.type.has_value());
        call.type = ParseTypeName(value);
        if (!call.type) {
            throw UsageError("unknown type '" + value + "'; the types are " + TypeNameList(),
                             command);
        }
    } else if (name == "time") {
        once(call.time.has_value());
        call.time = ParseIsoTime(value);
        if (!call.time && LacksOnlyAZone(value)) {
            throw UsageError("--time '" + value + "' has no zone: " + kAddAZone, command);
        }
        if (!call.time) {
            throw UsageError(
                "--time needs an ISO 8601 time with a zone, such as "
                "2026-03-01T08:30:00.250000Z, not '" +
                    value + "'",
                command);
        }
    } else if (name == "stdin") {
        call.fromStdin = true;
    } else if (name == "set") {
        call.set = true;
    } else if (name == "collect") {
        once(call.collect.has_value());
        if (value != "on" && value != "off") {
            throw UsageError("--collect takes on or off, not '" + value + "'", command);
        }
        call.collect = value == "on";
    } else if (name == "reset") {
        call.reset = true;
    } else if (name == "listen") {
        ParseListen(call, value);
    } else if (name == "instance") {
        once(call.instance.has_value());
        call.instance = ParseCount(name, value, command);
        if (*call.instance == 0) {
            throw UsageError("--instance needs 1 or more; 0 is the library's default instance",
                             command);
        }
    } else if (name == "allow-write") {
        call.allowWrite = true;
    }
}

// Checks and places the words that are not options.
void ApplyWords(Invocation& call, const std::vector<std::string>& words) {
    const Command command = call.command;
    switch (command) {
        case Command::Help:
            if (words.size() > 1) throw UsageError("help takes at most one command name", command);
            if (!words.empty()) {
                call.helpTopic = CommandByName(words.front());
                if (!call.helpTopic || *call.helpTopic == Command::Help) {
                    throw UsageError("no command named '" + words.front() + "'", std::nullopt);
                }
            }
            return;
        case Command::List:
            RequireCount(words, 1, command, "one PATTERN");
            if (words.front().empty()) throw UsageError("the pattern is empty", command);
            call.paths = words;
            return;
        case Command::Read:
        case Command::Delete:
            if (words.empty()) {
                throw UsageError(std::string(CommandName(command)) + " takes one PATH or more",
                                 command);
            }
            for (const auto& path : words) RequirePath(path, command);
            call.paths = words;
            return;
        case Command::Write:
            if (call.fromStdin) {
                if (!words.empty())
                    throw UsageError("write --stdin takes no PATH or VALUE", command);
                if (call.time) {
                    throw UsageError("write --stdin takes the times from its lines, not --time",
                                     command);
                }
                return;
            }
            RequireCount(words, 2, command, "PATH and VALUE (or --stdin)");
            RequirePath(words[0], command);
            call.paths = {words[0]};
            call.value = words[1];
            return;
        case Command::Create:
            RequireCount(words, 1, command, "one PATH");
            RequirePath(words[0], command);
            if (!call.type) throw UsageError("create needs --type", command);
            call.paths = words;
            return;
        case Command::Keywords:
        case Command::Properties:
            if (words.empty() || (!call.set && words.size() != 1)) {
                throw UsageError(std::string(CommandName(command)) +
                                     " takes one PATH, and with --set the new items after it",
                                 command);
            }
            RequirePath(words[0], command);
            call.paths = {words[0]};
            for (std::size_t i = 1; i < words.size(); ++i) {
                if (command == Command::Properties) {
                    call.properties.push_back(ParseProperty(words[i], command));
                } else if (words[i].empty()) {
                    throw UsageError("a keyword may not be empty", command);
                } else {
                    call.keywords.push_back(words[i]);
                }
            }
            return;
        case Command::Aggregates:
            RequireCount(words, 1, command, "one PATH");
            RequirePath(words[0], command);
            call.paths = words;
            return;
        case Command::Serve:
            RequireCount(words, 0, command, "no PATH or PATTERN");
            return;
    }
}

}  // namespace

std::optional<Command> CommandByName(std::string_view name) {
    for (const auto& entry : kCommands) {
        if (name == entry.name) return entry.command;
    }
    return std::nullopt;
}

const char* CommandName(Command command) {
    for (const auto& entry : kCommands) {
        if (entry.command == command) return entry.name;
    }
    return "?";
}

std::optional<std::string> TagPathProblem(const std::string& path) {
    if (path.empty()) return std::string("a tag path may not be empty");
    if (path.find('*') != std::string::npos) {
        return "a tag path may not hold '*' (use list for patterns): '" + path + "'";
    }
    return std::nullopt;
}

std::optional<uint32_t> ParseUint32(std::string_view text) {
    bool digits = !text.empty() && text.size() <= 10;
    for (const char c : text) digits = digits && c >= '0' && c <= '9';
    if (!digits) return std::nullopt;
    const unsigned long long value = std::strtoull(std::string(text).c_str(), nullptr, 10);
    if (value > UINT32_MAX) return std::nullopt;
    return static_cast<uint32_t>(value);
}

bool WantsJson(const std::vector<std::string>& args) {
    for (const auto& arg : args) {
        if (arg == "--") return false;
        if (arg == "--json") return true;
    }
    return false;
}

Invocation ParseCommandLine(const std::vector<std::string>& args) {
    Invocation call;
    bool haveCommand = false;
    bool help = false;
    bool optionsEnded = false;
    std::vector<RawOption> options;
    std::vector<std::string> words;
    for (std::size_t i = 0; i < args.size(); ++i) {
        const std::string& arg = args[i];
        const bool isOption =
            !optionsEnded && ((arg.size() > 2 && arg.compare(0, 2, "--") == 0) || arg == "-h");
        if (!optionsEnded && arg == "--") {
            optionsEnded = true;
            continue;
        }
        if (!isOption) {
            if (haveCommand) {
                words.push_back(arg);
                continue;
            }
            const auto command = CommandByName(arg);
            if (!command) throw UsageError("unknown command '" + arg + "'", std::nullopt);
            call.command = *command;
            haveCommand = true;
            continue;
        }
        RawOption option;
        if (arg == "-h") {
            option.name = "help";
        } else {
            const auto equals = arg.find('=');
            option.name =
                arg.substr(2, equals == std::string::npos ? std::string::npos : equals - 2);
            if (equals != std::string::npos) option.value = arg.substr(equals + 1);
        }
        if (TakesValue(option.name) && !option.value) {
            if (i + 1 >= args.size()) {
                throw UsageError("--" + option.name + " needs a value",
                                 haveCommand ? std::optional<Command>(call.command) : std::nullopt);
            }
            option.value = args[++i];
        } else if (!TakesValue(option.name) && option.value) {
            throw UsageError("--" + option.name + " takes no value",
                             haveCommand ? std::optional<Command>(call.command) : std::nullopt);
        }
        options.push_back(option);
    }
    for (const auto& option : options) help = help || option.name == "help";
    if (!haveCommand && !help) throw UsageError("no command given", std::nullopt);

    for (const auto& option : options) {
        if (!Allowed(call.command, option.name)) {
            const bool known = TakesValue(option.name) || option.name == "stdin" ||
                               option.name == "set" || option.name == "reset" ||
                               option.name == "allow-write";
            const std::optional<Command> where =
                haveCommand ? std::optional<Command>(call.command) : std::nullopt;
            throw UsageError(known ? "--" + option.name + " is not an option of " +
                                         (haveCommand ? CommandName(call.command) : "kvtag alone")
                                   : "unknown option --" + option.name,
                             where);
        }
        Apply(call, option, help);
    }
    if (help) {
        // "kvtag write --help" and "kvtag --help" ask for help, whatever else
        // the line holds.
        if (haveCommand && call.command != Command::Help) call.helpTopic = call.command;
        call.command = Command::Help;
        if (call.helpTopic) return call;
    }
    ApplyWords(call, words);
    return call;
}

}  // namespace kvtag
