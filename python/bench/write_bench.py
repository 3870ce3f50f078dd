#!/usr/bin/env python3
"""tag.write of one double from Python beside TagConsoleWriteTag from C++.

Each round measures the median time of CALLS writes after WARMUP untimed ones,
once from Python through kvveldra and once from C++ through the public
header (python_write_bench, a process of its own), in turns whose order
alternates, so that a machine that drifts in speed weighs on both alike. It
runs on the private broker of KVVELDRA_BROKER_ENV (else one of its own) with a
kvveldra-tagservice of its own, and prints the rounds and the line

    ratio | tag.write from Python / TagConsoleWriteTag from C++, p50 | <value> | <= 1.10

with the median of the rounds' ratios, as scripts/bench.sh gathers it.

    PYTHONPATH=build/python python3 python/bench/write_bench.py \\
        --cpp build/python/python_write_bench [--tagservice PATH] [--rounds 3]
"""

import argparse
import statistics
import subprocess
import sys
import time
from pathlib import Path

sys.dont_write_bytecode = True  # nothing into the source tree
sys.path.insert(0, str(Path(__file__).resolve().parents[1] / "support"))

import tagworld  # noqa: E402

import kvveldra  # noqa: E402

WHAT = "tag.write from Python / TagConsoleWriteTag from C++, p50"
TARGET = "<= 1.10"
PATH = "bench.python.write"


def python_p50_us(tag, calls, warmup):
    micros = []
    for i in range(warmup + calls):
        start = time.perf_counter_ns()
        tag.write(12.5 + i)
        if i >= warmup:
            micros.append((time.perf_counter_ns() - start) / 1000.0)
    return statistics.median(micros)


def cpp_p50_us(program, calls, warmup):
    done = subprocess.run([program, PATH, str(calls), str(warmup)], capture_output=True,
                          text=True, check=True, timeout=600)
    return float(done.stdout.split()[-1])


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--cpp", required=True, help="the python_write_bench program")
    parser.add_argument("--tagservice", default=tagworld.default_tagservice())
    parser.add_argument("--calls", type=int, default=2000)
    parser.add_argument("--warmup", type=int, default=200)
    parser.add_argument("--rounds", type=int, default=3)
    args = parser.parse_args()

    ratios = []
    with tagworld.TagWorld(args.tagservice, exchange="kvveldra.python.bench"):
        with kvveldra.Client() as client, client.create(PATH, kvveldra.DOUBLE) as tag:
            for round_number in range(args.rounds):
                if round_number % 2 == 0:
                    ours = python_p50_us(tag, args.calls, args.warmup)
                    theirs = cpp_p50_us(args.cpp, args.calls, args.warmup)
                else:
                    theirs = cpp_p50_us(args.cpp, args.calls, args.warmup)
                    ours = python_p50_us(tag, args.calls, args.warmup)
                ratios.append(ours / theirs)
                print(f"round {round_number + 1}: Python p50 {ours:.1f} us, "
                      f"C++ p50 {theirs:.1f} us, ratio {ours / theirs:.3f}", flush=True)
    print(f"ratio | {WHAT} | {statistics.median(ratios):.2f} | {TARGET}", flush=True)


if __name__ == "__main__":
    main()
