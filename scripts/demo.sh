#!/usr/bin/env bash
# Installs what is missing, builds the library and runs the demo end to end:
# a private RabbitMQ node, kvveldra-tagservice on it, and the demo program
# with its data root pointing at that node. Everything started here is
# stopped on the way out, whatever happens.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-broker

build="${BUILD_DIR:-build}"
# The tree's options stay as they are (scripts/test.sh shares it); only the
# two programs are built.
cmake -S . -B "$build" -G Ninja
cmake --build "$build" -j"$(nproc)" --target kvveldra-demo kvveldra-tagservice

work=$(mktemp -d "${TMPDIR:-/tmp}/kvveldra-demo.XXXXXX")
envfile="$work/broker.env"
service_pid=""

cleanup() {
    local status=$?
    if [ -n "$service_pid" ] && kill -0 "$service_pid" 2>/dev/null; then
        kill -TERM "$service_pid" 2>/dev/null || true
        wait "$service_pid" 2>/dev/null || true
    fi
    tests/integration/broker/broker.sh stop "$envfile" || true
    rm -rf -- "$work"
    exit "$status"
}
trap cleanup EXIT
trap 'exit 130' INT
trap 'exit 143' TERM

tests/integration/broker/broker.sh start "$envfile"
value() { sed -n "s/^$1='\(.*\)'\$/\1/p" "$envfile" | head -n 1; }

# The data root: one configuration file per id the programs may ask for, all
# naming the private node.
data="$work/data"
mkdir -p "$data/VeldraConfigurations"
for id in veldra_localhost veldra_master; do
    cat >"$data/VeldraConfigurations/$id.json" <<JSON
{"Id":"$id","DisplayName":"demo broker","ExchangeName":"kvveldra.demo","Host":"$(value BROKER_HOST)","Port":$(value BROKER_AMQP_PORT),"User":"$(value BROKER_USER)","Password":"$(value BROKER_PASSWORD)","UseTls":false}
JSON
done
export VELDRA_DATA_DIR="$data"

"$build/tools/tagservice/kvveldra-tagservice" --verbose --store "$work/tags.db" \
    >"$work/service.log" 2>&1 &
service_pid=$!
for _ in $(seq 1 300); do
    grep -q "kvveldra-tagservice ready" "$work/service.log" && break
    kill -0 "$service_pid" 2>/dev/null || break
    sleep 0.1
done
if ! grep -q "kvveldra-tagservice ready" "$work/service.log"; then
    echo "demo: kvveldra-tagservice did not start:" >&2
    cat "$work/service.log" >&2
    exit 1
fi

status=0
"$build/tools/demo/kvveldra-demo" || status=$?
if [ "$status" -ne 0 ]; then
    echo "--- kvveldra-tagservice output" >&2
    cat "$work/service.log" >&2
fi
exit "$status"
