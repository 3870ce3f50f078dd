#!/usr/bin/env bash
# Pipelined requests/s through a cluster's balancer against a single node, in
# the same run: service_roundtrip_bench's BM_PipelinedService, in turns, on a
# private node (tests/integration/broker/broker.sh) and on three private nodes
# behind haproxy (cluster.sh). Context for bench/README.md, no target.
#
#   bench/cluster_pipelined.sh [BUILD_DIR] [RUNS]      (defaults: build, 3)
set -euo pipefail
cd "$(dirname "$0")/.."

build=${1:-build}
runs=${2:-3}
bench="$build/bench/service_roundtrip_bench"
[ -x "$bench" ] || {
    echo "no $bench: build the target service_roundtrip_bench first" >&2
    exit 1
}

work=$(mktemp -d "${TMPDIR:-/tmp}/kvveldra-cluster-bench.XXXXXX")
cleanup() {
    tests/integration/broker/cluster.sh stop "$work/cluster.env" || true
    tests/integration/broker/broker.sh stop "$work/broker.env" || true
    rm -rf -- "$work"
}
trap cleanup EXIT
tests/integration/broker/broker.sh start "$work/broker.env"
tests/integration/broker/cluster.sh start "$work/cluster.env"

# requests_per_s of one run of the pipelined service benchmark on ENV_FILE.
rate() {
    KVVELDRA_BROKER_ENV=$1 "$bench" --benchmark_filter='^BM_PipelinedService/' \
        --benchmark_format=json 2>/dev/null |
        sed -n 's/^ *"requests_per_s": \([0-9.e+]*\).*/\1/p' | head -n 1
}

echo "load average before: $(cut -d' ' -f1-3 /proc/loadavg)"
for ((i = 1; i <= runs; i++)); do
    single=$(rate "$work/broker.env")
    balanced=$(rate "$work/cluster.env")
    printf 'run %d: single node %.0f requests/s, through the balancer %.0f requests/s\n' \
        "$i" "$single" "$balanced"
done
echo "load average after: $(cut -d' ' -f1-3 /proc/loadavg)"
