// kvtag: lists, reads, writes and manages tags through the console family
// of libkvveldra_tag. Exit status 0 on success, 1 on a usage error, 2 when
// the library, the broker or the service fails the request.
#include <csignal>
#include <cstdio>
#include <exception>
#include <iostream>
#include <string>
#include <vector>

#include "CommandLine.h"
#include "Commands.h"
#include "ConsoleSession.h"
#include "Failures.h"
#include "HelpText.h"
#include "OutputChannel.h"
#include "Report.h"
#include "ServeCommand.h"
#include "StdinLines.h"

namespace {

constexpr int kExitUsage = 1;
constexpr int kExitFailure = 2;

// The command's name for the JSON document, "kvtag" when there is none.
std::string CommandLabel(const std::vector<std::string>& args) {
    for (const auto& arg : args) {
        if (arg == "--") break;
        if (kvtag::CommandByName(arg)) return arg;
    }
    return "kvtag";
}

int ReportUsage(const kvtag::UsageError& failure, bool json, const std::string& label) {
    std::fprintf(stderr, "kvtag: %s\n", failure.what());
    const auto command = failure.HelpCommand();
    if (command && *command != kvtag::Command::Help) {
        std::fprintf(stderr, "Try 'kvtag %s --help' for more information.\n",
                     kvtag::CommandName(*command));
    } else {
        std::fprintf(stderr, "Try 'kvtag --help' for more information.\n");
    }
    if (json)
        std::printf("%s\n", kvtag::JsonFailure(label, "usage", nullptr, failure.what()).c_str());
    return kExitUsage;
}

int ReportFailure(const std::string& message, const int32_t* status, bool json,
                  const std::string& label, const char* kind) {
    std::fprintf(stderr, "kvtag: %s\n", message.c_str());
    if (json) std::printf("%s\n", kvtag::JsonFailure(label, kind, status, message).c_str());
    return kExitFailure;
}

// Runs a parsed command line that needs the broker.
int RunSession(const kvtag::Invocation& call, const std::vector<kvtag::TagBatch>& batches,
               const std::string& label) {
    kvtag::Rendered rendered;
    {
        // The library may print to standard output; while it is in use,
        // that goes to standard error.
        kvtag::OutputChannel output;
        {
            kvtag::Reservation reservation;
            kvtag::ConsoleInstance instance(call.global);
            rendered = kvtag::RunCommand(call, instance, batches);
        }
        const std::string text =
            call.global.json ? kvtag::JsonSuccess(label, rendered.json) + "\n" : rendered.text;
        if (!output.Write(text)) return kExitFailure;
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    std::signal(SIGPIPE, SIG_IGN);
    const std::vector<std::string> args(argv + 1, argv + argc);
    const bool json = kvtag::WantsJson(args);
    // The best guess until the line is parsed, then the command itself.
    std::string label = CommandLabel(args);
    try {
        const kvtag::Invocation call = kvtag::ParseCommandLine(args);
        label = kvtag::CommandName(call.command);
        if (call.command == kvtag::Command::Help) {
            std::fputs(kvtag::HelpText(call.helpTopic).c_str(), stdout);
            return 0;
        }
        if (call.command == kvtag::Command::Serve) return kvtag::RunServe(call);
        std::vector<kvtag::TagBatch> batches;
        if (call.command == kvtag::Command::Write && call.fromStdin) {
            try {
                batches = kvtag::ReadStdinBatches(std::cin);
            } catch (const kvtag::LineError& failure) {
                throw kvtag::UsageError(failure.what(), kvtag::Command::Write);
            }
        }
        kvtag::CheckBeforeSending(call, batches);
        return RunSession(call, batches, label);
    } catch (const kvtag::UsageError& failure) {
        return ReportUsage(failure, json, label);
    } catch (const kvtag::LibraryError& failure) {
        const int32_t status = failure.Status();
        return ReportFailure(failure.what(), &status, json, label, "library");
    } catch (const kvtag::ToolError& failure) {
        return ReportFailure(failure.what(), nullptr, json, label, "tool");
    } catch (const std::exception& failure) {
        return ReportFailure(std::string("unexpected failure: ") + failure.what(), nullptr, json,
                             label, "tool");
    }
}
