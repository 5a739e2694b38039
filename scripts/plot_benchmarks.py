#!/usr/bin/python3
"""Turns the JSON output of the benchmark binary into the figures of
docs/performance.md: a Markdown table of every chain size and lookup, and a
PNG plot of the time per link against the links per chain for the swing
step, the limit loop and Box2D. Times are CPU times, the median of the
repetitions when the run had several.

    build/release/bench/chains_bench --benchmark_repetitions=5 \\
        --benchmark_format=json > bench.json
    scripts/plot_benchmarks.py bench.json docs/performance.png

Needs Debian's python3-matplotlib, which the tests do not install.
"""
import json
import re
import sys

import matplotlib

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402

FAMILIES = {"SwingStep": "swing step", "SwingLimit": "limit loop", "Box2DChain": "Box2D"}
ARGUMENT = re.compile(r"/\w+:(\d+)")


def results(path):
    """{(family, arguments...): entry}: the median of each benchmark, or its only run."""
    with open(path) as file:
        data = json.load(file)
    found = {}
    for entry in data["benchmarks"]:
        if entry.get("run_type") == "aggregate" and entry.get("aggregate_name") != "median":
            continue
        name = entry["run_name"]
        key = (name.split("/")[0], *(int(value) for value in ARGUMENT.findall(name)))
        if entry.get("aggregate_name") == "median" or key not in found:
            found[key] = entry
    return data["context"], found


def microseconds(entry):
    scale = {"ns": 1e-3, "us": 1.0, "ms": 1e3, "s": 1e6}[entry["time_unit"]]
    return entry["cpu_time"] * scale


def table(found):
    sizes = sorted({key[1:] for key in found if key[0] == "SwingStep"}, key=lambda s: (s[0] * s[1], s))
    print("| C x M | step µs | limit µs | Box2D µs | step ns/link | step/limit | Box2D/step |")
    print("|---|---:|---:|---:|---:|---:|---:|")
    for chains, links in sizes:
        step, limit, box2d = (found[(family, chains, links)] for family in FAMILIES)
        print(f"| {chains} x {links} | {microseconds(step):.3f} | {microseconds(limit):.3f} | "
              f"{microseconds(box2d):.1f} | {step['ns_per_link'] * 1e9:.2f} | "
              f"{microseconds(step) / microseconds(limit):.2f} | {microseconds(box2d) / microseconds(step):.0f} |")
    print()
    print("| lookup | objects | object | ns |")
    print("|---|---:|---|---:|")
    for key, entry in sorted(found.items()):
        if "Index" in key[0]:
            which = "found nowhere" if key[2:] == (0,) else "near the end" if key[2:] == (1,) else "after a removal"
            print(f"| {key[0]} | {key[1]} | {which} | {microseconds(entry) * 1e3:,.1f} |")


def plot(context, found, output):
    figure, axes = plt.subplots(figsize=(8, 6))
    styles = {1: "-", 10: "--", 100: ":"}
    colours = {"SwingStep": "tab:blue", "SwingLimit": "tab:green", "Box2DChain": "tab:red"}
    for family, label in FAMILIES.items():
        for chains, style in styles.items():
            points = sorted((key[2], entry["ns_per_link"] * 1e9)
                            for key, entry in found.items() if key[0] == family and key[1] == chains)
            if points:
                axes.plot(*zip(*points), style, marker="o", color=colours[family], label=f"{label}, {chains} chain(s)")
    axes.set_xscale("log")
    axes.set_yscale("log")
    axes.set_xlabel("links per chain (M)")
    axes.set_ylabel("CPU ns per link and frame")
    axes.set_title(f"One frame of C chains of M links ({context['num_cpus']} cores, {context['mhz_per_cpu']} MHz)")
    axes.grid(True, which="both", alpha=0.3)
    axes.legend(fontsize="small", ncol=3, loc="upper center", bbox_to_anchor=(0.5, -0.12))
    figure.tight_layout()
    figure.savefig(output, dpi=100)


def main():
    if len(sys.argv) != 3:
        sys.exit("usage: plot_benchmarks.py BENCH.json OUTPUT.png")
    context, found = results(sys.argv[1])
    table(found)
    plot(context, found, sys.argv[2])


if __name__ == "__main__":
    main()
