#pragma once

#include <gtest/gtest.h>
#include <sys/types.h>

#include <set>
#include <string>
#include <vector>

#include "support/CommandRunner.h"

namespace Korvane::Veldra::Testing {

// Control of the private cluster that tests/integration/broker/cluster.sh
// started: its nodes are numbered 1 to kClusterNodes; Broker() is its balancer.
inline constexpr int kClusterNodes = 3;

// cluster.sh COMMAND ENV_FILE ARGS..., bounded by timeoutSeconds.
CommandResult ClusterScript(const std::string& command, const std::vector<std::string>& args,
                            int timeoutSeconds);

// SIGKILL to every process of node `node`; RestartClusterNode starts it again
// and returns once it runs in the cluster and the balancer sends to it.
::testing::AssertionResult KillClusterNode(int node);
::testing::AssertionResult RestartClusterNode(int node);

// One client connection as the cluster lists it: the node it is on, the
// client's own port (the balancer passes it on), and the broker's name for it.
struct ClusterConnection {
    int node = 0;
    int clientPort = 0;
    std::string pid;
};

// Every client connection of the cluster, asked of node `via`.
::testing::AssertionResult ListClusterConnections(int via, std::vector<ClusterConnection>& out);

// Has the broker close one connection; the client reconnects through the
// balancer, which sends it to the next node in turn.
::testing::AssertionResult CloseClusterConnection(int via, const std::string& pid);

// The nodes the cluster runs, as node `via` sees them.
::testing::AssertionResult RunningNodes(int via, std::set<int>& nodes);

// The node that keeps queue `queue`: its home, or the leader of a quorum queue.
::testing::AssertionResult QueueNode(int via, const std::string& queue, int& node);

// Waits, bounded, until every node runs a member of quorum queue `queue`: a
// node that was restarted rejoins the queue's members some time after it
// rejoined the cluster, and until then the queue lives on a bare majority.
::testing::AssertionResult AwaitAllMembersOnline(int via, const std::string& queue);

// The local ports of process `pid`'s TCP connections to 127.0.0.1:`port`.
std::set<int> LocalPortsTo(pid_t pid, int port);

// The number of Erlang runtimes (beam.smp) of the cluster's nodes.
int NodeRuntimeCount();

}  // namespace Korvane::Veldra::Testing
