#!/usr/bin/env bash
# Starts and stops a private RabbitMQ node for the integration tests.
#
#   broker.sh start ENV_FILE   start a node, write its settings to ENV_FILE
#   broker.sh stop  ENV_FILE   stop the node ENV_FILE describes, remove its files
#   broker.sh env   ENV_FILE   print ENV_FILE if its node is still running
#   broker.sh ctl   ENV_FILE ARGS...   run rabbitmqctl ARGS on that node
#   broker.sh kill  ENV_FILE   SIGKILL the node, keeping its files and ports
#   broker.sh restart ENV_FILE start a killed node again on the same files and ports
#
# The node never touches a system-wide broker: it has its own directory under
# $TMPDIR (owned by the "rabbitmq" user when started as root), its own node
# name, Erlang cookie, configuration, epmd and ports, all on 127.0.0.1 only.
# It listens for AMQP and for AMQP over TLS (certificates made here by openssl).
#
# Every wait is bounded; KVVELDRA_BROKER_START_TIMEOUT (seconds, default 120)
# bounds the start. Several instances may run at the same time.
set -euo pipefail

readonly RABBITMQ_BIN="${KVVELDRA_RABBITMQ_BIN:-/usr/lib/rabbitmq/bin}"
readonly START_TIMEOUT="${KVVELDRA_BROKER_START_TIMEOUT:-120}"
readonly STOP_TIMEOUT=60
readonly PORT_LOCK="${TMPDIR:-/tmp}/kvveldra-broker-ports.lock"
readonly CLEAN_PATH=/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin

log() { printf 'broker: %s\n' "$*" >&2; }
die() {
    log "$*"
    exit 1
}

# --- helpers ----------------------------------------------------------------

require_tools() {
    local tool
    [ -x "$RABBITMQ_BIN/rabbitmq-server" ] && [ -x "$RABBITMQ_BIN/rabbitmqctl" ] ||
        die "rabbitmq-server is not installed (no $RABBITMQ_BIN/rabbitmq-server);" \
            "run scripts/install-deps.sh --with-broker"
    for tool in openssl epmd timeout flock setpriv; do
        command -v "$tool" >/dev/null || die "required tool '$tool' not found"
    done
}

# Local TCP ports in use, in any state, from the kernel's tables.
ports_in_use() {
    local f local_address rest
    for f in /proc/net/tcp /proc/net/tcp6; do
        [ -r "$f" ] || continue
        while read -r _ local_address rest; do
            if [[ "$local_address" == *:* ]]; then echo $((16#${local_address##*:})); fi
        done <"$f"
    done | sort -un
}

# Prints N distinct free ports from 20000-32767, below the kernel's ephemeral
# range so that outgoing connections never take them.
pick_ports() {
    local count=$1 used chosen=() port tries=0
    used=" $(ports_in_use | tr '\n' ' ') "
    while [ ${#chosen[@]} -lt "$count" ]; do
        tries=$((tries + 1))
        [ $tries -le 1000 ] || die "no free loopback ports found"
        port=$((20000 + (RANDOM * 32768 + RANDOM) % 12768))
        case "$used" in *" $port "*) continue ;; esac
        used="$used$port "
        chosen+=("$port")
    done
    echo "${chosen[@]}"
}

# Pids of every process started for the node in DIR: all of them carry
# KVVELDRA_BROKER_DIR=DIR in their environment.
node_pids() {
    local dir=$1
    grep -lzxF "KVVELDRA_BROKER_DIR=$dir" /proc/[0-9]*/environ 2>/dev/null |
        sed 's|^/proc/\([0-9]*\)/environ$|\1|' || true
}

# SIGTERM to the processes of DIR, then SIGKILL to those left; bounded.
end_node_pids() {
    local dir=$1
    kill_node_pids "$dir" TERM 10 || kill_node_pids "$dir" KILL 5 ||
        log "some processes of $dir would not die"
}

# Signals the node's processes and waits up to SECONDS for them to go.
kill_node_pids() {
    local dir=$1 signal=$2 seconds=$3 pids i
    pids=$(node_pids "$dir")
    [ -n "$pids" ] || return 0
    # shellcheck disable=SC2086
    kill -s "$signal" $pids 2>/dev/null || true
    for ((i = 0; i < seconds * 10; i++)); do
        [ -n "$(node_pids "$dir")" ] || return 0
        sleep 0.1
    done
    return 1
}

read_env_value() {
    local file=$1 key=$2
    sed -n "s/^$key='\(.*\)'\$/\1/p" "$file" | head -n 1
}

write_certificates() {
    local tls=$1 tag=$2
    cat >"$tls/openssl.cnf" <<'EOF'
[req]
distinguished_name = dn
prompt = no
[dn]
CN = placeholder
[ca_ext]
basicConstraints = critical, CA:TRUE
keyUsage = critical, keyCertSign, cRLSign
subjectKeyIdentifier = hash
[server_ext]
basicConstraints = critical, CA:FALSE
keyUsage = critical, digitalSignature, keyEncipherment
extendedKeyUsage = serverAuth
subjectAltName = DNS:localhost, IP:127.0.0.1
subjectKeyIdentifier = hash
authorityKeyIdentifier = keyid
EOF
    local ec=(-newkey ec -pkeyopt ec_paramgen_curve:prime256v1 -nodes)
    local req=(openssl req -config "$tls/openssl.cnf")
    "${req[@]}" -x509 "${ec[@]}" -days 30 -extensions ca_ext \
        -subj "/CN=kvveldra test CA $tag" -keyout "$tls/ca.key" -out "$tls/ca.pem" 2>/dev/null
    "${req[@]}" -x509 "${ec[@]}" -days 30 -extensions ca_ext \
        -subj "/CN=kvveldra unrelated CA $tag" -keyout "$tls/other-ca.key" \
        -out "$tls/other-ca.pem" 2>/dev/null
    "${req[@]}" -new "${ec[@]}" -subj "/CN=localhost" \
        -keyout "$tls/server.key" -out "$tls/server.csr" 2>/dev/null
    openssl x509 -req -in "$tls/server.csr" -CA "$tls/ca.pem" -CAkey "$tls/ca.key" \
        -CAcreateserial -days 30 -extfile "$tls/openssl.cnf" -extensions server_ext \
        -out "$tls/server.pem" 2>/dev/null
    rm -f "$tls/server.csr" "$tls/ca.srl"
    chmod 644 "$tls"/*.pem
    chmod 600 "$tls"/*.key
}

# The user and group the node runs as: "rabbitmq" when started by root.
node_owner() {
    if [ "$(id -u)" -eq 0 ]; then
        id rabbitmq >/dev/null 2>&1 || die "user 'rabbitmq' does not exist"
        echo "rabbitmq $(id -gn rabbitmq)"
    else
        echo "$(id -un) $(id -gn)"
    fi
}

# DIR/rabbitmq.conf: AMQP on 127.0.0.1:AMQP and AMQP over TLS on
# 127.0.0.1:AMQPS with the certificates in TLS_DIR.
write_rabbitmq_conf() {
    local dir=$1 amqp=$2 amqps=$3 tls=$4
    cat >"$dir/rabbitmq.conf" <<EOF
listeners.tcp.1 = 127.0.0.1:$amqp
listeners.ssl.1 = 127.0.0.1:$amqps
ssl_options.cacertfile = $tls/ca.pem
ssl_options.certfile = $tls/server.pem
ssl_options.keyfile = $tls/server.key
ssl_options.verify = verify_none
ssl_options.fail_if_no_peer_cert = false
loopback_users = none
disk_free_limit.absolute = 10MB
log.console = false
log.file.level = ${KVVELDRA_BROKER_LOG_LEVEL:-info}
EOF
}

# DIR/node.env: the node's whole environment; the launcher and rabbitmqctl
# both use it.
write_node_env() {
    local dir=$1 node=$2 dist=$3 epmd_port=$4
    cat >"$dir/node.env" <<EOF
KVVELDRA_BROKER_DIR=$dir
HOME=$dir
PATH=$CLEAN_PATH
LC_ALL=C.UTF-8
LANG=C.UTF-8
RABBITMQ_NODENAME=$node
RABBITMQ_USE_LONGNAME=false
RABBITMQ_CONF_ENV_FILE=$dir/rabbitmq-env.conf
RABBITMQ_CONFIG_FILE=$dir/rabbitmq.conf
RABBITMQ_ADVANCED_CONFIG_FILE=$dir/advanced.config
RABBITMQ_ENABLED_PLUGINS_FILE=$dir/enabled_plugins
RABBITMQ_MNESIA_BASE=$dir/mnesia
RABBITMQ_LOG_BASE=$dir/log
RABBITMQ_LOGS=$dir/log/node.log
RABBITMQ_PID_FILE=$dir/node.pid
RABBITMQ_PLUGINS_EXPAND_DIR=$dir/plugins-expand
RABBITMQ_FEATURE_FLAGS_FILE=$dir/feature_flags
RABBITMQ_DIST_PORT=$dist
ERL_EPMD_PORT=$epmd_port
ERL_EPMD_ADDRESS=127.0.0.1
RABBITMQ_SERVER_ADDITIONAL_ERL_ARGS="-kernel inet_dist_use_interface {127,0,0,1}"
RABBITMQ_CTL_ERL_ARGS="-kernel inet_dist_use_interface {127,0,0,1}"
RABBITMQ_CTL_DIST_PORT_MIN=0
RABBITMQ_CTL_DIST_PORT_MAX=0
EOF
}

# --- commands ---------------------------------------------------------------

cmd_start() {
    local envfile=$1
    require_tools
    mkdir -p "$(dirname "$envfile")"
    envfile="$(cd "$(dirname "$envfile")" && pwd)/$(basename "$envfile")"
    # A node left by an earlier run, finished or interrupted, goes first.
    cmd_stop "$envfile"

    local user group
    read -r user group <<<"$(node_owner)"

    local started=$SECONDS dir
    dir=$(mktemp -d "${TMPDIR:-/tmp}/kvveldra-broker.XXXXXX")
    chmod 755 "$dir"
    # From here on a failure or a signal takes the node and its directory
    # down again; should even that fail, "stop" finds them through .starting.
    echo "BROKER_DIR='$dir'" >"$envfile.starting"
    trap "abort_start '$dir' '$envfile'" EXIT
    trap 'exit 1' HUP INT TERM

    mkdir -p "$dir/mnesia" "$dir/log" "$dir/tls" "$dir/bin"
    local node="kvveldra-test-$$@localhost"
    write_certificates "$dir/tls" "$$"
    echo '[].' >"$dir/enabled_plugins"
    : >"$dir/rabbitmq-env.conf"
    od -An -N16 -tx1 /dev/urandom | tr -d ' \n' >"$dir/.erlang.cookie"
    chmod 400 "$dir/.erlang.cookie"

    # Ports are chosen and bound under a lock shared with other instances.
    # (A read-only descriptor is enough for flock, whoever created the file.)
    [ -e "$PORT_LOCK" ] || : >>"$PORT_LOCK"
    exec 9<"$PORT_LOCK"
    flock -w "$START_TIMEOUT" 9 || die "timed out waiting for $PORT_LOCK"
    local ports amqp amqps dist epmd_port
    ports=$(pick_ports 4)
    read -r amqp amqps dist epmd_port <<<"$ports"

    write_rabbitmq_conf "$dir" "$amqp" "$amqps" "$dir/tls"
    write_node_env "$dir" "$node" "$dist" "$epmd_port"
    make_launchers "$dir" "$user" "$group"
    chown -R "$user:$group" "$dir"

    launch_node "$dir" "$epmd_port"
    exec 9>&-

    local tmp="$envfile.tmp.$$"
    cat >"$tmp" <<EOF
# Written by broker.sh for the private test node; removed by "broker.sh stop".
BROKER_DIR='$dir'
BROKER_HOST='127.0.0.1'
BROKER_HOSTNAME='localhost'
BROKER_AMQP_PORT='$amqp'
BROKER_AMQPS_PORT='$amqps'
BROKER_USER='guest'
BROKER_PASSWORD='guest'
BROKER_VHOST='/'
BROKER_CA_CERT='$dir/tls/ca.pem'
BROKER_OTHER_CA_CERT='$dir/tls/other-ca.pem'
BROKER_SERVER_CERT='$dir/tls/server.pem'
BROKER_NODE='$node'
BROKER_DIST_PORT='$dist'
BROKER_EPMD_PORT='$epmd_port'
BROKER_CTL='$dir/bin/rabbitmqctl'
BROKER_LOG='$dir/log/node.log'
EOF
    mv -f "$tmp" "$envfile"
    rm -f -- "$envfile.starting"
    trap - EXIT HUP INT TERM
    log "node $node up in $((SECONDS - started))s: amqp 127.0.0.1:$amqp," \
        "amqps 127.0.0.1:$amqps, settings in $envfile"
}

# Starts epmd and the node from DIR and waits for the node to run. Both run
# in sessions of their own, detached from our output, so that a caller
# reading our output (ctest) is not kept waiting by them.
launch_node() {
    local dir=$1 epmd_port=$2
    start_epmd "$dir" "$epmd_port"
    launch_server "$dir"
}

# epmd on 127.0.0.1:PORT as a process of DIR.
start_epmd() {
    local dir=$1 epmd_port=$2
    setsid "$dir/bin/run" epmd -port "$epmd_port" -address 127.0.0.1 \
        </dev/null >>"$dir/log/epmd.log" 2>&1 9>&- &
}

# The node of DIR alone, on an epmd that runs already; waits until it runs.
launch_server() {
    local dir=$1 server
    setsid "$dir/bin/run" "$RABBITMQ_BIN/rabbitmq-server" \
        </dev/null >>"$dir/log/startup.log" 2>&1 9>&- &
    server=$!
    wait_for_node "$dir" "$server"
}

# bin/run starts a program as the node's user with nothing but the node's
# environment; bin/rabbitmqctl runs rabbitmqctl against this node.
make_launchers() {
    local dir=$1 user=$2 group=$3 setpriv
    setpriv=$(command -v setpriv)
    cat >"$dir/bin/run" <<EOF
#!/bin/sh
if [ "\$(id -u)" -eq 0 ] && [ "$user" != root ]; then
    exec env -i $setpriv --reuid=$user --regid=$group --init-groups "$dir/bin/with-env" "\$@"
fi
exec env -i "$dir/bin/with-env" "\$@"
EOF
    cat >"$dir/bin/with-env" <<EOF
#!/bin/sh
set -a
. "$dir/node.env"
set +a
cd "$dir" || exit 1
exec "\$@"
EOF
    cat >"$dir/bin/rabbitmqctl" <<EOF
#!/bin/sh
# rabbitmqctl for the private test node in $dir, and for no other node.
exec "$dir/bin/run" "$RABBITMQ_BIN/rabbitmqctl" "\$@"
EOF
    chmod 755 "$dir/bin/run" "$dir/bin/with-env" "$dir/bin/rabbitmqctl"
}

# Waits until the node's application runs, the node dies, or time runs out.
wait_for_node() {
    local dir=$1 server=$2 waiter
    timeout -k 5 "$START_TIMEOUT" "$dir/bin/rabbitmqctl" wait --timeout "$START_TIMEOUT" \
        "$dir/node.pid" >"$dir/log/wait.log" 2>&1 9>&- &
    waiter=$!
    while kill -0 "$waiter" 2>/dev/null; do
        if ! kill -0 "$server" 2>/dev/null; then
            kill "$waiter" 2>/dev/null || true
            wait "$waiter" 2>/dev/null || true
            die "the node exited during start"
        fi
        sleep 0.2
    done
    wait "$waiter" || die "the node did not come up within ${START_TIMEOUT}s"
}

# EXIT trap of a failed start: show why, then take everything down.
abort_start() {
    local dir=$1 envfile=$2 f
    trap - EXIT
    log "start failed; logs of $dir follow"
    for f in "$dir"/log/startup.log "$dir"/log/wait.log "$dir"/log/node.log; do
        [ -s "$f" ] || continue
        echo "----- $f (last 40 lines)" >&2
        tail -n 40 "$f" >&2
    done
    kill_node_pids "$dir" TERM 10 || kill_node_pids "$dir" KILL 5 || true
    rm -rf -- "$dir"
    rm -f -- "$envfile" "$envfile.starting"
    exit 1
}

# Stops the node whose directory FILE names, then removes the directory and FILE.
stop_node_of() {
    local file=$1 dir
    dir=$(read_env_value "$file" BROKER_DIR)
    case "$dir" in
    */kvveldra-broker.??????) ;;
    *) die "$file does not describe a test node (BROKER_DIR='$dir')" ;;
    esac
    if [ -n "$(node_pids "$dir")" ]; then
        timeout -k 5 "$STOP_TIMEOUT" "$dir/bin/rabbitmqctl" stop "$dir/node.pid" \
            >"$dir/log/stop.log" 2>&1 || log "rabbitmqctl stop failed; killing the node"
        end_node_pids "$dir"
    fi
    rm -rf -- "$dir"
    rm -f -- "$file"
    log "stopped the node of $dir"
}

# Runs STOPPER FILE on ENV_FILE.starting and ENV_FILE, whichever exist.
stop_env_files() {
    local envfile=$1 stopper=$2 file
    for file in "$envfile.starting" "$envfile"; do
        if [ -f "$file" ]; then "$stopper" "$file"; fi
    done
}

cmd_stop() {
    stop_env_files "$1" stop_node_of
}

cmd_env() {
    local envfile=$1 dir
    [ -f "$envfile" ] || die "no $envfile: the node is not running"
    dir=$(read_env_value "$envfile" BROKER_DIR)
    [ -n "$(node_pids "$dir")" ] || die "the node of $envfile is gone"
    cat "$envfile"
}

cmd_ctl() {
    local envfile=$1
    shift
    [ -f "$envfile" ] || die "no $envfile: the node is not running"
    exec "$(read_env_value "$envfile" BROKER_CTL)" "$@"
}

# The directory of the running test node that ENV_FILE describes.
node_dir_of() {
    local envfile=$1 dir
    [ -f "$envfile" ] || die "no $envfile: the node is not running"
    dir=$(read_env_value "$envfile" BROKER_DIR)
    case "$dir" in
    */kvveldra-broker.??????) ;;
    *) die "$envfile does not describe a test node (BROKER_DIR='$dir')" ;;
    esac
    echo "$dir"
}

# Kills every process of the node at once (SIGKILL), as a crash would; its
# directory, data and settings stay for "restart".
cmd_kill() {
    local dir
    dir=$(node_dir_of "$1")
    kill_node_pids "$dir" KILL 10 || die "some processes of $dir would not die"
    log "killed the node of $dir"
}

# Starts the node of ENV_FILE again on its ports and data, after "kill".
cmd_restart() {
    local envfile=$1 dir started=$SECONDS
    dir=$(node_dir_of "$envfile")
    [ -z "$(node_pids "$dir")" ] || die "the node of $dir still runs; kill it first"
    rm -f -- "$dir/node.pid"
    launch_node "$dir" "$(read_env_value "$envfile" BROKER_EPMD_PORT)"
    log "restarted the node of $dir in $((SECONDS - started))s"
}

main() {
    [ $# -ge 2 ] || die "usage: $0 start|stop|env|ctl|kill|restart ENV_FILE [ARGS...]"
    local command=$1 envfile=$2
    shift 2
    case "$command" in
    start) cmd_start "$envfile" ;;
    stop) cmd_stop "$envfile" ;;
    env) cmd_env "$envfile" ;;
    ctl) cmd_ctl "$envfile" "$@" ;;
    kill) cmd_kill "$envfile" ;;
    restart) cmd_restart "$envfile" ;;
    *) die "unknown command '$command'" ;;
    esac
}

# Sourced (by cluster.sh) for its functions alone.
if [ "${BASH_SOURCE[0]}" = "$0" ]; then main "$@"; fi
