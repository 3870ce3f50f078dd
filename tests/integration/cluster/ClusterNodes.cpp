#include "cluster/ClusterNodes.h"

#include <dirent.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <map>
#include <sstream>

#include "support/BrokerEnvironment.h"
#include "support/BrokerSettings.h"

namespace Korvane::Veldra::Testing {
namespace {

// Before the broker environment reads it: the cluster's file is this
// executable's broker, unless KVVELDRA_BROKER_ENV names another.
[[maybe_unused]] const int clusterEnvironment =
    setenv("KVVELDRA_BROKER_ENV", KVVELDRA_CLUSTER_ENV_FILE, 0);

::testing::AssertionResult Succeeded(const std::string& what, const CommandResult& result) {
    if (result.Ok()) return ::testing::AssertionSuccess();
    return ::testing::AssertionFailure() << what << " exited with " << result.ExitCode << ":\n"
                                         << result.Output;
}

// The node names of the env file, by number.
const std::map<std::string, int>& NodeNumbers() {
    static const std::map<std::string, int> numbers = [] {
        std::ifstream file(BrokerEnvironment::EnvFilePath());
        std::ostringstream text;
        text << file.rdbuf();
        std::map<std::string, std::string> values;
        std::string error;
        std::map<std::string, int> found;
        if (!ParseEnvLines(text.str(), values, error)) return found;
        for (int node = 1; node <= kClusterNodes; ++node) {
            const auto name = values.find("NODE" + std::to_string(node) + "_NAME");
            if (name != values.end()) found[name->second] = node;
        }
        return found;
    }();
    return numbers;
}

// The node a broker process id ("<name@host.1.2.3>") or a node name is on; 0
// when none of the cluster's.
int NodeOf(const std::string& text) {
    for (const auto& [name, node] : NodeNumbers()) {
        if (text == name || text.rfind("<" + name + ".", 0) == 0) return node;
    }
    return 0;
}

// rabbitmqctl -q --silent ARGS on node `via`, one entry per line, split at tabs.
::testing::AssertionResult CtlRows(int via, const std::vector<std::string>& args,
                                   std::vector<std::vector<std::string>>& rows) {
    std::vector<std::string> ctlArgs{std::to_string(via), "-q", "--silent"};
    ctlArgs.insert(ctlArgs.end(), args.begin(), args.end());
    const CommandResult result = ClusterScript("ctl", ctlArgs, 60);
    if (!result.Ok()) return Succeeded("rabbitmqctl " + args.front(), result);
    rows.clear();
    std::istringstream lines(result.Output);
    std::string line;
    while (std::getline(lines, line)) {
        std::vector<std::string> fields;
        std::istringstream cells(line);
        std::string cell;
        while (std::getline(cells, cell, '\t')) fields.push_back(cell);
        if (!fields.empty()) rows.push_back(fields);
    }
    return ::testing::AssertionSuccess();
}

}  // namespace

CommandResult ClusterScript(const std::string& command, const std::vector<std::string>& args,
                            int timeoutSeconds) {
    std::vector<std::string> argv{"bash", KVVELDRA_CLUSTER_SCRIPT, command,
                                  BrokerEnvironment::EnvFilePath()};
    argv.insert(argv.end(), args.begin(), args.end());
    return RunCommand(argv, timeoutSeconds);
}

::testing::AssertionResult KillClusterNode(int node) {
    return Succeeded("cluster.sh kill-node", ClusterScript("kill-node", {std::to_string(node)}, 30));
}

::testing::AssertionResult RestartClusterNode(int node) {
    return Succeeded("cluster.sh restart-node",
                     ClusterScript("restart-node", {std::to_string(node)}, 180));
}

::testing::AssertionResult ListClusterConnections(int via, std::vector<ClusterConnection>& out) {
    std::vector<std::vector<std::string>> rows;
    auto listed = CtlRows(via, {"list_connections", "pid", "peer_port"}, rows);
    if (!listed) return listed;
    out.clear();
    for (const auto& row : rows) {
        if (row.size() != 2) return ::testing::AssertionFailure() << "odd connection line";
        out.push_back({NodeOf(row[0]), std::stoi(row[1]), row[0]});
    }
    return ::testing::AssertionSuccess();
}

::testing::AssertionResult CloseClusterConnection(int via, const std::string& pid) {
    return Succeeded("rabbitmqctl close_connection",
                     ClusterScript("ctl", {std::to_string(via), "-q", "close_connection", pid,
                                           "moved by the test"}, 60));
}

::testing::AssertionResult RunningNodes(int via, std::set<int>& nodes) {
    const CommandResult result =
        ClusterScript("ctl", {std::to_string(via), "-q", "eval", "rabbit_nodes:all_running()."}, 60);
    if (!result.Ok()) return Succeeded("rabbitmqctl eval", result);
    nodes.clear();
    for (const auto& [name, node] : NodeNumbers()) {
        if (result.Output.find("'" + name + "'") != std::string::npos) nodes.insert(node);
    }
    return ::testing::AssertionSuccess();
}

::testing::AssertionResult QueueNode(int via, const std::string& queue, int& node) {
    std::vector<std::vector<std::string>> rows;
    auto listed = CtlRows(via, {"list_queues", "name", "pid"}, rows);
    if (!listed) return listed;
    for (const auto& row : rows) {
        if (row.size() == 2 && row[0] == queue && (node = NodeOf(row[1])) != 0) {
            return ::testing::AssertionSuccess();
        }
    }
    return ::testing::AssertionFailure() << "no queue " << queue << " on a node of the cluster";
}

::testing::AssertionResult AwaitAllMembersOnline(int via, const std::string& queue) {
    std::string online;
    for (int round = 0; round < 60; ++round) {
        std::vector<std::vector<std::string>> rows;
        auto listed = CtlRows(via, {"list_queues", "name", "online"}, rows);
        if (!listed) return listed;
        for (const auto& row : rows) {
            if (row.size() != 2 || row[0] != queue) continue;
            online = row[1];
            int members = 0;
            for (const auto& entry : NodeNumbers()) {
                if (online.find(entry.first) != std::string::npos) ++members;
            }
            if (members == kClusterNodes) return ::testing::AssertionSuccess();
        }
    }
    return ::testing::AssertionFailure() << "queue " << queue << " has online members " << online;
}

std::set<int> LocalPortsTo(pid_t pid, int port) {
    // The process's socket inodes, then their rows in the kernel's table:
    // "sl local_address rem_address st ... inode", addresses as hex IP:port.
    std::set<std::string> inodes;
    const std::string fdDir = "/proc/" + std::to_string(pid) + "/fd";
    if (DIR* dir = opendir(fdDir.c_str())) {
        while (const dirent* entry = readdir(dir)) {
            char target[128];
            const ssize_t size =
                readlink((fdDir + "/" + entry->d_name).c_str(), target, sizeof target - 1);
            const std::string link(target, size > 0 ? static_cast<size_t>(size) : 0);
            if (link.rfind("socket:[", 0) == 0) inodes.insert(link.substr(8, link.size() - 9));
        }
        closedir(dir);
    }
    char remote[32];
    std::snprintf(remote, sizeof remote, "0100007F:%04X", port);
    std::set<int> ports;
    std::ifstream table("/proc/net/tcp");
    std::string line;
    std::getline(table, line);
    while (std::getline(table, line)) {
        std::istringstream fields(line);
        std::string slot, local, rem, state, queues, timer, retransmits, uid, timeout, inode;
        fields >> slot >> local >> rem >> state >> queues >> timer >> retransmits >> uid >> timeout >>
            inode;
        if (rem == remote && state == "01" && inodes.count(inode) != 0) {
            ports.insert(std::stoi(local.substr(local.find(':') + 1), nullptr, 16));
        }
    }
    return ports;
}

int NodeRuntimeCount() {
    int count = 0;
    const std::string mark = "KVVELDRA_BROKER_DIR=" + Broker().Directory + "/node";
    DIR* proc = opendir("/proc");
    if (proc == nullptr) return -1;
    while (const dirent* entry = readdir(proc)) {
        const std::string base = std::string("/proc/") + entry->d_name;
        std::ifstream comm(base + "/comm");
        std::string name;
        if (!std::getline(comm, name) || name != "beam.smp") continue;
        std::ifstream environ(base + "/environ");
        std::string variable;
        while (std::getline(environ, variable, '\0')) {
            if (variable.rfind(mark, 0) == 0) {
                ++count;
                break;
            }
        }
    }
    closedir(proc);
    return count;
}

}  // namespace Korvane::Veldra::Testing
