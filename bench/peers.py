"""Measures what Python libraries need for the operations of the benchmark programs. The scripts <family>_peers.py take
those flags of Google Benchmark that tools/bench uses, and leave their figures in its form."""

import argparse
import json
import pathlib
import re
import time


def seconds_of(function, calls):
    start = time.process_time()
    for _ in range(calls):
        function()
    return time.process_time() - start


def measure(cases):
    """Times each function of `cases`, a dictionary by name: operation/who/argument:value/..."""
    parser = argparse.ArgumentParser()
    parser.add_argument("--benchmark_out", type=pathlib.Path)
    parser.add_argument("--benchmark_filter", default="")
    parser.add_argument("--benchmark_min_time", type=float, default=0.3)
    parser.add_argument("--benchmark_repetitions", type=int, default=1)
    options = parser.parse_known_args()[0]

    measured = []
    for name, function in cases.items():
        if not re.search(options.benchmark_filter, name):
            continue
        function()  # plans and caches are made once
        calls = 1
        while (spent := seconds_of(function, calls)) < options.benchmark_min_time / 2:
            calls = max(2 * calls, round(calls * min(10.0, 0.6 * options.benchmark_min_time / max(spent, 1e-9))))
        for _ in range(options.benchmark_repetitions):
            nanoseconds = 1e9 * seconds_of(function, calls) / calls
            measured.append({"name": name, "run_type": "iteration", "iterations": calls, "cpu_time": nanoseconds,
                             "time_unit": "ns"})
        print(f"{name:60s}{min(m['cpu_time'] for m in measured if m['name'] == name):16.0f} ns", flush=True)
    if options.benchmark_out:
        options.benchmark_out.write_text(json.dumps({"benchmarks": measured}))
