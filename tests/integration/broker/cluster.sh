#!/usr/bin/env bash
# Starts and stops a private cluster of three RabbitMQ nodes behind haproxy for
# the cluster tests.
#
#   cluster.sh start ENV_FILE               start the cluster, write its settings to ENV_FILE
#   cluster.sh stop ENV_FILE                stop everything ENV_FILE describes, remove its files
#   cluster.sh ctl ENV_FILE N ARGS...       run rabbitmqctl ARGS on node N (1-3)
#   cluster.sh kill-node ENV_FILE N         SIGKILL node N, keeping its files and ports
#   cluster.sh restart-node ENV_FILE N      start a killed node N again; it rejoins
#   cluster.sh balancer ENV_FILE            print each node's state as the balancer sees it
#
# Each node is made as broker.sh makes its single node (same user, launchers,
# configuration, all on 127.0.0.1, nothing of a system-wide broker), with its
# own directory, node name and ports; the three share one Erlang cookie and one
# epmd, and nodes 2 and 3 join node 1 with `rabbitmqctl join_cluster`. haproxy
# listens on a free loopback port in TCP mode, balances round robin, checks
# each node's AMQP port and hands each node the client's address with the PROXY
# protocol, so that the broker's connection list shows the client's own port.
#
# ENV_FILE holds the balancer as BROKER_HOST/BROKER_AMQP_PORT/BROKER_AMQPS_PORT
# (what BrokerSettings reads) and NODE<N>_NAME, NODE<N>_AMQP_PORT,
# NODE<N>_DIST_PORT, NODE<N>_CTL of each node. Every wait is bounded.
set -euo pipefail

# shellcheck source=broker.sh
. "$(dirname "${BASH_SOURCE[0]}")/broker.sh"

readonly NODES=3
readonly BALANCER_TIMEOUT=30

log() { printf 'cluster: %s\n' "$*" >&2; }

# --- helpers ----------------------------------------------------------------

# The cluster's directory from ENV_FILE (or its .starting file).
cluster_dir_of() {
    local file=$1 dir
    dir=$(read_env_value "$file" CLUSTER_DIR)
    case "$dir" in
    */kvveldra-cluster.??????) echo "$dir" ;;
    *) die "$file does not describe a test cluster (CLUSTER_DIR='$dir')" ;;
    esac
}

# The directory of node N of the running cluster ENV_FILE describes.
node_dir() {
    local envfile=$1 n=$2
    [[ "$n" =~ ^[1-9]$ ]] && [ "$n" -le "$NODES" ] || die "no node '$n': nodes are 1 to $NODES"
    [ -f "$envfile" ] || die "no $envfile: the cluster is not running"
    echo "$(cluster_dir_of "$envfile")/node$n"
}

# The files of node N in TOP: configuration, cookie, environment, launchers.
make_node() {
    local top=$1 n=$2 name=$3 amqp=$4 amqps=$5 dist=$6 epmd_port=$7 user=$8 group=$9
    local dir=$top/node$n
    mkdir -p "$dir/mnesia" "$dir/log" "$dir/bin"
    write_rabbitmq_conf "$dir" "$amqp" "$amqps" "$top/tls"
    echo "proxy_protocol = true" >>"$dir/rabbitmq.conf"
    echo '[].' >"$dir/enabled_plugins"
    : >"$dir/rabbitmq-env.conf"
    cp "$top/.erlang.cookie" "$dir/.erlang.cookie"
    chmod 400 "$dir/.erlang.cookie"
    write_node_env "$dir" "$name" "$dist" "$epmd_port"
    make_launchers "$dir" "$user" "$group"
}

# TOP/haproxy.cfg: AMQP and AMQP over TLS balanced over the nodes' ports, and
# the statistics page on STATS. A connect to a dead node is retried on the next.
write_haproxy_cfg() {
    local top=$1 amqp=$2 amqps=$3 stats=$4 n
    shift 4
    local pairs=("$@")
    {
        cat <<EOF
global
    maxconn 1000

defaults
    mode tcp
    timeout connect 1s
    timeout client 10m
    timeout server 10m
    timeout check 1s
    retries 3
    option redispatch 1
    default-server check inter 1s fastinter 250ms fall 2 rise 2 send-proxy

listen amqp
    bind 127.0.0.1:$amqp
    balance roundrobin
EOF
        for ((n = 1; n <= NODES; n++)); do echo "    server node$n 127.0.0.1:${pairs[n - 1]%/*}"; done
        cat <<EOF

listen amqps
    bind 127.0.0.1:$amqps
    balance roundrobin
EOF
        for ((n = 1; n <= NODES; n++)); do echo "    server node$n 127.0.0.1:${pairs[n - 1]#*/}"; done
        cat <<EOF

listen stats
    mode http
    bind 127.0.0.1:$stats
    stats enable
    stats uri /stats
EOF
    } >"$top/haproxy.cfg"
}

# "node<N> <status>" for each server of the balancer's amqp proxy, from its
# statistics page (bash's /dev/tcp: no client program needed).
balancer_states() {
    local stats=$1
    timeout 5 bash -c '
        exec 3<>"/dev/tcp/127.0.0.1/$1" || exit 1
        printf "GET /stats;csv HTTP/1.0\r\n\r\n" >&3
        cat <&3' _ "$stats" | awk -F, '$1 == "amqp" && $2 ~ /^node/ { print $2, $18 }'
}

# Waits until the balancer's state of node N starts with STATE (UP, DOWN).
wait_for_balancer() {
    local stats=$1 n=$2 state=$3 i
    for ((i = 0; i < BALANCER_TIMEOUT * 10; i++)); do
        if balancer_states "$stats" | grep -q "^node$n $state"; then return 0; fi
        sleep 0.1
    done
    die "the balancer did not see node $n $state within ${BALANCER_TIMEOUT}s"
}

# Starts the servers of the given node directories at once; fails unless
# every one comes up.
launch_servers() {
    local dir pids=() failed=0 pid
    for dir in "$@"; do
        launch_server "$dir" &
        pids+=($!)
    done
    for pid in "${pids[@]}"; do wait "$pid" || failed=1; done
    [ "$failed" -eq 0 ] || die "a node did not start"
}

# --- commands ---------------------------------------------------------------

cluster_start() {
    local envfile=$1
    require_tools
    command -v haproxy >/dev/null ||
        die "haproxy is not installed; run scripts/install-deps.sh --with-cluster"
    mkdir -p "$(dirname "$envfile")"
    envfile="$(cd "$(dirname "$envfile")" && pwd)/$(basename "$envfile")"
    cluster_stop "$envfile"

    local user group started=$SECONDS top
    read -r user group <<<"$(node_owner)"
    top=$(mktemp -d "${TMPDIR:-/tmp}/kvveldra-cluster.XXXXXX")
    chmod 755 "$top"
    echo "CLUSTER_DIR='$top'" >"$envfile.starting"
    trap "abort_cluster_start '$top' '$envfile'" EXIT
    trap 'exit 1' HUP INT TERM

    mkdir -p "$top/log" "$top/tls" "$top/bin"
    write_certificates "$top/tls" "$$"
    od -An -N16 -tx1 /dev/urandom | tr -d ' \n' >"$top/.erlang.cookie"
    # epmd and haproxy are the cluster's own processes, found through TOP.
    printf 'KVVELDRA_BROKER_DIR=%s\nHOME=%s\nPATH=%s\nLC_ALL=C.UTF-8\n' \
        "$top" "$top" "$CLEAN_PATH" >"$top/node.env"
    make_launchers "$top" "$user" "$group"
    rm -f "$top/bin/rabbitmqctl"

    [ -e "$PORT_LOCK" ] || : >>"$PORT_LOCK"
    exec 9<"$PORT_LOCK"
    flock -w "$START_TIMEOUT" 9 || die "timed out waiting for $PORT_LOCK"
    local ports lb_amqp lb_amqps stats epmd_port n names=() amqp=() amqps=() dist=() pairs=()
    read -r -a ports <<<"$(pick_ports $((4 + 3 * NODES)))"
    lb_amqp=${ports[0]} lb_amqps=${ports[1]} stats=${ports[2]} epmd_port=${ports[3]}
    for ((n = 1; n <= NODES; n++)); do
        names[n]="kvveldra-cluster-$$-$n@localhost"
        amqp[n]=${ports[3 * n + 1]} amqps[n]=${ports[3 * n + 2]} dist[n]=${ports[3 * n + 3]}
        pairs+=("${amqp[n]}/${amqps[n]}")
        make_node "$top" "$n" "${names[n]}" "${amqp[n]}" "${amqps[n]}" "${dist[n]}" \
            "$epmd_port" "$user" "$group"
    done
    write_haproxy_cfg "$top" "$lb_amqp" "$lb_amqps" "$stats" "${pairs[@]}"
    haproxy -c -q -f "$top/haproxy.cfg" || die "haproxy rejects $top/haproxy.cfg"
    chown -R "$user:$group" "$top"

    start_epmd "$top" "$epmd_port"
    launch_servers "$top"/node[0-9]
    setsid "$top/bin/run" haproxy -db -f "$top/haproxy.cfg" \
        </dev/null >>"$top/log/haproxy.log" 2>&1 9>&- &
    exec 9>&-
    log "nodes up in $((SECONDS - started))s; joining them"

    for ((n = 2; n <= NODES; n++)); do
        local ctl=(timeout -k 5 "$START_TIMEOUT" "$top/node$n/bin/rabbitmqctl" -q)
        { "${ctl[@]}" stop_app && "${ctl[@]}" join_cluster "${names[1]}" &&
            "${ctl[@]}" start_app; } >>"$top/log/join.log" 2>&1 || die "node $n did not join"
    done
    for ((n = 1; n <= NODES; n++)); do wait_for_balancer "$stats" "$n" UP; done

    local tmp="$envfile.tmp.$$" boot=$((SECONDS - started))
    {
        cat <<EOF
# Written by cluster.sh for the private test cluster; removed by "cluster.sh stop".
CLUSTER_DIR='$top'
CLUSTER_BOOT_SECONDS='$boot'
CLUSTER_STATS_PORT='$stats'
BROKER_DIR='$top'
BROKER_HOST='127.0.0.1'
BROKER_HOSTNAME='localhost'
BROKER_AMQP_PORT='$lb_amqp'
BROKER_AMQPS_PORT='$lb_amqps'
BROKER_USER='guest'
BROKER_PASSWORD='guest'
BROKER_VHOST='/'
BROKER_CA_CERT='$top/tls/ca.pem'
BROKER_OTHER_CA_CERT='$top/tls/other-ca.pem'
BROKER_SERVER_CERT='$top/tls/server.pem'
BROKER_NODE='${names[1]}'
BROKER_EPMD_PORT='$epmd_port'
BROKER_CTL='$top/node1/bin/rabbitmqctl'
BROKER_LOG='$top/node1/log/node.log'
EOF
        for ((n = 1; n <= NODES; n++)); do
            cat <<EOF
NODE${n}_NAME='${names[n]}'
NODE${n}_AMQP_PORT='${amqp[n]}'
NODE${n}_AMQPS_PORT='${amqps[n]}'
NODE${n}_DIST_PORT='${dist[n]}'
NODE${n}_CTL='$top/node$n/bin/rabbitmqctl'
EOF
        done
    } >"$tmp"
    mv -f "$tmp" "$envfile"
    rm -f -- "$envfile.starting"
    trap - EXIT HUP INT TERM
    log "cluster of $NODES nodes up in ${boot}s: balancer amqp 127.0.0.1:$lb_amqp," \
        "amqps 127.0.0.1:$lb_amqps, settings in $envfile"
}

# EXIT trap of a failed start: show why, then take everything down.
abort_cluster_start() {
    local top=$1 envfile=$2 f
    trap - EXIT
    log "start failed; logs of $top follow"
    for f in "$top"/log/*.log "$top"/node[0-9]/log/startup.log "$top"/node[0-9]/log/wait.log \
        "$top"/node[0-9]/log/node.log; do
        [ -s "$f" ] || continue
        echo "----- $f (last 30 lines)" >&2
        tail -n 30 "$f" >&2
    done
    stop_cluster_of "$envfile.starting"
    rm -f -- "$envfile"
    exit 1
}

# Stops the nodes (at once, each bounded), then haproxy and epmd, then removes
# the directory and FILE.
stop_cluster_of() {
    local file=$1 top dir pids=() pid
    top=$(cluster_dir_of "$file")
    for dir in "$top"/node[0-9]; do
        [ -n "$(node_pids "$dir")" ] || continue
        timeout -k 5 "$STOP_TIMEOUT" "$dir/bin/rabbitmqctl" stop "$dir/node.pid" \
            >"$dir/log/stop.log" 2>&1 &
        pids+=($!)
    done
    for pid in "${pids[@]}"; do wait "$pid" || log "a rabbitmqctl stop failed; killing"; done
    for dir in "$top"/node[0-9] "$top"; do end_node_pids "$dir"; done
    rm -rf -- "$top"
    rm -f -- "$file"
    log "stopped the cluster of $top"
}

cluster_stop() {
    stop_env_files "$1" stop_cluster_of
}

cluster_ctl() {
    local dir
    dir=$(node_dir "$1" "${2:-}")
    shift 2
    exec "$dir/bin/rabbitmqctl" "$@"
}

# Kills every process of node N at once, as a crash would.
cluster_kill_node() {
    local dir
    dir=$(node_dir "$1" "$2")
    kill_node_pids "$dir" KILL 10 || die "some processes of $dir would not die"
    log "killed node $2"
}

# Starts killed node N again on its data; returns once it runs in the cluster
# and the balancer sends connections to it again.
cluster_restart_node() {
    local envfile=$1 n=$2 dir started=$SECONDS
    dir=$(node_dir "$envfile" "$n")
    [ -z "$(node_pids "$dir")" ] || die "node $n still runs; kill it first"
    rm -f -- "$dir/node.pid"
    launch_server "$dir"
    wait_for_balancer "$(read_env_value "$envfile" CLUSTER_STATS_PORT)" "$n" UP
    log "restarted node $n in $((SECONDS - started))s"
}

cluster_main() {
    [ $# -ge 2 ] ||
        die "usage: $0 start|stop|balancer|ctl|kill-node|restart-node ENV_FILE [N] [ARGS...]"
    local command=$1 envfile=$2
    shift 2
    case "$command" in
    start) cluster_start "$envfile" ;;
    stop) cluster_stop "$envfile" ;;
    balancer)
        [ -f "$envfile" ] || die "no $envfile: the cluster is not running"
        balancer_states "$(read_env_value "$envfile" CLUSTER_STATS_PORT)"
        ;;
    ctl) cluster_ctl "$envfile" "$@" ;;
    kill-node) cluster_kill_node "$envfile" "${1:-}" ;;
    restart-node) cluster_restart_node "$envfile" "${1:-}" ;;
    *) die "unknown command '$command'" ;;
    esac
}

cluster_main "$@"
