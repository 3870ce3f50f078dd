#!/usr/bin/env bash
# Runs every benchmark on a private RabbitMQ node and prints one table of
# ratios, each against its baseline measured in the same process run.
#
#   scripts/bench.sh                 install what is missing, build, run, print the table
#
# Environment:
#   BUILD_DIR                 build directory (default build-bench, RelWithDebInfo as the README builds)
#   BENCH_RUNS                how often each benchmark runs (default 3); the table gives
#                             the range over the runs
#   KVVELDRA_MEMORY_REQUESTS  requests of the resident-size run (default 1000000)
#   BENCH_LOG                 where the benchmarks' own output goes (default a temp file,
#                             named at the end)
#
# The console, open and scale benchmarks start their own kvveldra-tagservice
# on the node (the scale benchmark's listing over an SQLite store it fills
# first). Run it on a quiet machine: the load average before and after is
# printed with the table.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-deps.sh --with-broker

build="${BUILD_DIR:-build-bench}"
runs="${BENCH_RUNS:-3}"
cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo -DKVVELDRA_BENCH=ON >/dev/null
cmake --build "$build" -j"$(nproc)"

work=$(mktemp -d "${TMPDIR:-/tmp}/kvveldra-bench.XXXXXX")
envfile="$work/broker.env"
log="${BENCH_LOG:-$work/bench.log}"
keep_log=""
[ -n "${BENCH_LOG:-}" ] || keep_log="$(mktemp "${TMPDIR:-/tmp}/kvveldra-bench-log.XXXXXX")"

cleanup() {
    local status=$?
    tests/integration/broker/broker.sh stop "$envfile" >/dev/null 2>&1 || true
    if [ -n "$keep_log" ] && [ -f "$log" ]; then cp "$log" "$keep_log"; fi
    rm -rf -- "$work"
    exit "$status"
}
trap cleanup EXIT
trap 'exit 130' INT
trap 'exit 143' TERM

tests/integration/broker/broker.sh start "$envfile"
export KVVELDRA_BROKER_ENV="$envfile"
: >"$log"

load_before=$(cut -d' ' -f1-3 /proc/loadavg)
benches=(json_bench service_roundtrip_bench console_bench client_open_bench tagservice_bench
         trace_logger_bench scale_bench wb_bench)
for run in $(seq 1 "$runs"); do
    for bench in "${benches[@]}"; do
        [ -x "$build/bench/$bench" ] || { echo "not built: $bench" >&2; continue; }
        echo "== run $run: $bench" | tee -a "$log" >&2
        "$build/bench/$bench" --benchmark_color=false >>"$log" 2>&1 || echo "$bench failed (see $log)" >&2
    done
done
echo "== memory_bench" | tee -a "$log" >&2
"$build/bench/memory_bench" >>"$log" 2>&1 || echo "memory_bench failed (see $log)" >&2

# The Python module's tag.write beside the C++ call (python/bench/write_bench.py),
# when the tree built the module.
if [ -x "$build/python/python_write_bench" ] && [ -f "$build/python/kvveldra/__init__.py" ]; then
    for run in $(seq 1 "$runs"); do
        echo "== run $run: python write_bench" | tee -a "$log" >&2
        PYTHONPATH="$build/python" KVVELDRA_TAGSERVICE="$build/tools/tagservice/kvveldra-tagservice" \
            /usr/bin/python3 python/bench/write_bench.py --cpp "$build/python/python_write_bench" \
            >>"$log" 2>&1 || echo "python write_bench failed (see $log)" >&2
    done
fi
load_after=$(cut -d' ' -f1-3 /proc/loadavg)

# "ratio | what | value | target" lines, the same what once per run: one row
# each, with the lowest and highest value.
echo
echo "Ratios against the baseline of the same run ($runs runs; $(nproc) cores;" \
     "load average before $load_before, after $load_after)"
awk -F' [|] ' '
    $1 == "ratio" {
        what = $2; value = $3; target = $4
        if (!(what in seen)) { order[++n] = what; seen[what] = 1; low[what] = ""; high[what] = "" }
        targets[what] = target
        if (value == "n/a") { missing[what] = 1; next }
        if (low[what] == "" || value + 0 < low[what] + 0) low[what] = value
        if (high[what] == "" || value + 0 > high[what] + 0) high[what] = value
    }
    END {
        printf "%-62s %-13s %s\n", "ratio", "range", "target"
        for (i = 1; i <= n; ++i) {
            w = order[i]
            range = low[w] == "" ? "n/a" : (low[w] == high[w] ? low[w] : low[w] " to " high[w])
            if (missing[w] && low[w] != "") range = range " (some n/a)"
            printf "%-62s %-13s %s\n", w, range, targets[w]
        }
    }' "$log"
echo
echo "The benchmarks' own output: ${keep_log:-$log}"
