#pragma once

#include <kvveldra/TagConsole.h>

#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace kvtag {

enum class Command {
    Help,
    List,
    Read,
    Write,
    Create,
    Keywords,
    Properties,
    Aggregates,
    Delete,
    Serve
};

// The subcommand of a name ("list", "read", ...); nothing for other names.
std::optional<Command> CommandByName(std::string_view name);
const char* CommandName(Command command);

// Options of every subcommand.
struct GlobalOptions {
    std::optional<std::string> config;  // --config ID
    std::optional<uint32_t> timeoutMs;  // --timeout MS
    bool json = false;                  // --json
    bool verbose = false;               // --verbose
};

// One parsed command line. Fields a subcommand does not use stay at their
// defaults.
struct Invocation {
    GlobalOptions global;
    Command command = Command::Help;
    std::optional<Command> helpTopic;  // Help: the subcommand asked about

    // list: the one pattern; read, delete: the paths; others: the one path.
    std::vector<std::string> paths;

    uint32_t skip = 0;  // list --skip
    uint32_t take = 0;  // list --take, 0 for no limit
    // list --keyword (filters); keywords --set (the new set).
    std::vector<std::string> keywords;
    // list --property (filters); properties --set (the new set).
    std::vector<std::pair<std::string, std::string>> properties;

    std::optional<int32_t> type;         // write, create --type
    std::string value;                   // write VALUE
    std::optional<TagConsoleTime> time;  // write --time
    bool fromStdin = false;              // write --stdin

    bool set = false;             // keywords, properties --set
    std::optional<bool> collect;  // aggregates --collect on|off
    bool reset = false;           // aggregates --reset

    std::string listenHost = "127.0.0.1";  // serve --listen HOST:PORT
    uint16_t listenPort = 8080;            // 0: any free port
    std::optional<uint64_t> instance;      // serve --instance N (1 or more)
    bool allowWrite = false;               // serve --allow-write
};

// A command line that cannot be run: the message, and the subcommand whose
// help to point at (none: the tool's).
class UsageError : public std::runtime_error {
public:
    UsageError(const std::string& message, std::optional<Command> command)
        : std::runtime_error(message), command_(command) {}
    std::optional<Command> HelpCommand() const { return command_; }

private:
    std::optional<Command> command_;
};

// Parses the arguments after the program name; throws UsageError. Options
// start with "--" (or are "-h"); "--" ends them, so that a value may start
// with "--". Global options may stand anywhere; "--name=value" and
// "--name value" are both accepted.
Invocation ParseCommandLine(const std::vector<std::string>& args);

// True when the arguments ask for JSON output, so that even a usage error
// is answered in JSON.
bool WantsJson(const std::vector<std::string>& args);

// A whole number of decimal digits from 0 to 4294967295; nothing for any
// other text.
std::optional<uint32_t> ParseUint32(std::string_view text);

// Why a text cannot be the exact path of one tag, or nothing when it can.
std::optional<std::string> TagPathProblem(const std::string& path);

}  // namespace kvtag
