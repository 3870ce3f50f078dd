#include "HelpText.h"

#include "TagTypes.h"

namespace kvtag {
namespace {

constexpr const char* kGlobal =
    "Global options (anywhere on the line):\n"
    "  --config ID     the broker configuration whose \"Id\" is ID (matched without\n"
    "                  regard to case; the file's name does not count), among the\n"
    "                  .json files in VeldraConfigurations under the data root\n"
    "                  ($VELDRA_DATA_DIR, else /etc/korvane/kvveldra); default:\n"
    "                  veldra_master, else veldra_localhost. One of those two must\n"
    "                  exist even when --config names another\n"
    "  --timeout MS    0 to 4294967295: how long connecting to the broker may take\n"
    "                  (default 10000; 0: one attempt); each request then waits\n"
    "                  up to 10 s for the tag service's answer\n"
    "  --json          print exactly one JSON document on standard output\n"
    "  --verbose       show the library's progress on standard error\n"
    "  --help, -h      show help\n";

constexpr const char* kTool =
    "Usage: kvtag [global options] COMMAND [arguments]\n"
    "\n"
    "Reads and writes tags of the tag service.\n"
    "\n"
    "Commands:\n"
    "  list PATTERN      list the tags whose paths match ('*' matches any run)\n"
    "  read PATH...      read the current values\n"
    "  write PATH VALUE  write one value; write --stdin writes many\n"
    "  create PATH       create a tag of a type\n"
    "  keywords PATH     show or replace the keywords of a tag\n"
    "  properties PATH   show or replace the properties of a tag\n"
    "  aggregates PATH   show, switch or reset the aggregates of a tag\n"
    "  delete PATH...    delete tags\n"
    "  serve             serve a live page of tags over HTTP\n"
    "  help [COMMAND]    show help of a command ('kvtag COMMAND --help' too)\n"
    "\n";

constexpr const char* kToolNotes =
    "Times: ISO 8601 with a zone, e.g. 2026-03-01T08:30:00.250000Z; printed in UTC.\n"
    "Text output: one record a line, fields separated by tabs; in paths, values,\n"
    "keywords and properties a backslash is shown as \\\\, a tab as \\t, a line feed\n"
    "as \\n, a carriage return as \\r, other control characters as \\xHH.\n"
    "Exit status: 0 success, 1 usage error, 2 failure of the library or the service.\n";

// The types and the other names each is known by.
std::string TypesText() {
    return "Types (names in any case):\n  " + TypeNameList("\n  ") + "\n";
}

const char* CommandHelp(Command command) {
    switch (command) {
        case Command::List:
            return "Usage: kvtag list PATTERN [--skip N] [--take N] [--keyword K]... "
                   "[--property K=V]...\n"
                   "\n"
                   "Lists the tags whose paths match PATTERN, one line each: PATH, a tab, TYPE.\n"
                   "'*' matches any run of characters, dots included.\n"
                   "  --skip N        leave out the first N matches\n"
                   "  --take N        show at most N matches (0, the default: all)\n"
                   "  --keyword K     only tags with keyword K, case-sensitive (repeatable)\n"
                   "  --property K=V  only tags whose property K is V (repeatable)\n"
                   "When the page holds fewer than all matches, the count goes to standard "
                   "error.\n";
        case Command::Read:
            return "Usage: kvtag read PATH...\n"
                   "\n"
                   "Reads the current values, one line per tag: PATH, TYPE, VALUE, TIME,\n"
                   "separated by tabs, and the aggregates when the tag counted any. A tag\n"
                   "never written shows '-' for its time. No tag is created.\n";
        case Command::Write:
            return "Usage: kvtag write PATH VALUE [--type T] [--time ISO-TIME]\n"
                   "       kvtag write --stdin [--type T]\n"
                   "\n"
                   "Writes a value with its time (default: now). The value must suit the tag's\n"
                   "type; a tag that does not exist is created when --type is given, and\n"
                   "--type must agree with an existing tag.\n"
                   "With --stdin, each line of standard input is PATH VALUE [TIME]; a word may\n"
                   "be in double quotes (\\\" and \\\\ inside); empty lines and lines starting\n"
                   "with # are skipped. The lines of one tag go out in one write, in their\n"
                   "order. A bad line is a usage error naming its number, and then nothing\n"
                   "is written.\n";
        case Command::Create:
            return "Usage: kvtag create PATH --type T\n"
                   "\n"
                   "Creates a tag of type T. A tag that exists already is an error.\n";
        case Command::Keywords:
            return "Usage: kvtag keywords PATH [--set [K...]]\n"
                   "\n"
                   "Shows the keywords of a tag, one a line. With --set, the words after PATH\n"
                   "replace them (none: the tag keeps no keywords). Keywords are\n"
                   "case-sensitive.\n";
        case Command::Properties:
            return "Usage: kvtag properties PATH [--set [K=V...]]\n"
                   "\n"
                   "Shows the properties of a tag, one KEY=VALUE a line, sorted by key. With\n"
                   "--set, the KEY=VALUE words after PATH replace them.\n";
        case Command::Aggregates:
            return "Usage: kvtag aggregates PATH [--collect on|off] [--reset]\n"
                   "\n"
                   "Shows whether the tag collects aggregates, and its count, average,\n"
                   "minimum and maximum; before the first sample the last three show '-'\n"
                   "(null in JSON). --collect switches collecting, --reset starts the\n"
                   "aggregates anew; the state is shown after both.\n";
        case Command::Delete:
            return "Usage: kvtag delete PATH...\n"
                   "\n"
                   "Deletes the tags. All must exist; else nothing is deleted.\n";
        case Command::Serve:
            return "Usage: kvtag serve [--listen HOST:PORT] [--instance N] [--allow-write]\n"
                   "\n"
                   "Serves a page of tags over HTTP until interrupted: a search by the\n"
                   "patterns of list, the current values and aggregates refreshed once a\n"
                   "second, and a plot of the last 10 minutes of the tags selected. The page\n"
                   "reads the JSON API under /api/ (list, read, trend, write).\n"
                   "  --listen HOST:PORT  the address to listen on (default 127.0.0.1:8080;\n"
                   "                      port 0: any free port); anything but loopback lets\n"
                   "                      other machines read the tags\n"
                   "  --instance N        the console instance id to use (default 1)\n"
                   "  --allow-write       let the page write values (POST /api/write, with\n"
                   "                      the token the page carries); read-only without it\n"
                   "Once listening it prints 'kvtag serve: listening on http://HOST:PORT/'.\n";
        case Command::Help:
            return "Usage: kvtag help [COMMAND]\n";
    }
    return "";
}

}  // namespace

std::string HelpText(std::optional<Command> command) {
    if (!command || *command == Command::Help) {
        return std::string(kTool) + TypesText() + "\n" + kToolNotes + "\n" + kGlobal;
    }
    const bool typed = *command == Command::Write || *command == Command::Create;
    return std::string(CommandHelp(*command)) + (typed ? "\n" + TypesText() : "") + "\n" + kGlobal;
}

}  // namespace kvtag
