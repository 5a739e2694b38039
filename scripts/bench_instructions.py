#!/usr/bin/python3
"""Instructions per frame of the swing step, the limit loop and the Box2D
chain, counted by callgrind for every chain size of the benchmark binary, and
their ratios as a Markdown table. Instruction counts do not depend on what
else the machine runs, so the ratios hold where wall-clock times are noisy.

    scripts/bench_instructions.py [build/release/bench/chains_bench]

Needs valgrind (callgrind and callgrind_annotate), which the tests do not install.
"""
import re
import subprocess
import sys
import tempfile
from pathlib import Path

SIZES = [(c, m) for c in (1, 10, 100) for m in (1, 10, 100, 1000)] + [(1, 100000)]
MEASURED = {  # the function each benchmark calls once per frame
    "standin::Host::RunFrame()": "step",
    "LimitFrame(LimitChains&)": "limit",
    "b2World::Step(float, int, int)": "box2d",
}
ENTRY = re.compile(r"\s*([\d,]+) \([^)]*\)\s+\*\s+\S*?:(.*?) \[")
CALLS = re.compile(r"\((\d[\d,]*)x\)")


def per_call(profile):
    """Inclusive instructions per call of each measured function."""
    text = subprocess.run(["callgrind_annotate", "--inclusive=yes", "--tree=caller", "--threshold=100", profile],
                          check=True, capture_output=True, text=True).stdout
    lines = text.split("\n")
    result = {}
    for i, line in enumerate(lines):
        entry = ENTRY.match(line)
        if not entry or entry.group(2) not in MEASURED:
            continue
        calls, j = 0, i - 1
        while j >= 0 and lines[j].strip():  # the callers, each with its count of calls
            count = CALLS.search(lines[j])
            if count:
                calls += int(count.group(1).replace(",", ""))
            j -= 1
        result[MEASURED[entry.group(2)]] = int(entry.group(1).replace(",", "")) / calls
    return result


def main():
    binary = sys.argv[1] if len(sys.argv) > 1 else "build/release/bench/chains_bench"
    print("| C x M | step Ir/frame | limit Ir/frame | Box2D Ir/frame | step Ir/link | step/limit | Box2D/step |")
    print("|---|---:|---:|---:|---:|---:|---:|")
    with tempfile.TemporaryDirectory() as scratch:
        for chains, links in SIZES:
            profile = str(Path(scratch) / f"{chains}x{links}.out")
            pattern = f"^(SwingStep|SwingLimit|Box2DChain)/chains:{chains}/links:{links}$"
            subprocess.run(["valgrind", "--tool=callgrind", f"--callgrind-out-file={profile}", binary,
                            f"--benchmark_filter={pattern}", "--benchmark_min_time=0.1"],
                           check=True, capture_output=True)
            ir = per_call(profile)
            print(f"| {chains} x {links} | {ir['step']:,.0f} | {ir['limit']:,.0f} | {ir['box2d']:,.0f} | "
                  f"{ir['step'] / (chains * links):.1f} | {ir['step'] / ir['limit']:.2f} | "
                  f"{ir['box2d'] / ir['step']:.0f} |", flush=True)


if __name__ == "__main__":
    main()
