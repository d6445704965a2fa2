"""Prints a ratio table from Google Benchmark JSON files: "QD/<case>" against "Qt/<case>"."""
import json
import sys


def load(paths):
    """CPU time in ns per benchmark: the median when repetitions were run, else the run."""
    times, medians = {}, {}
    for path in paths:
        with open(path) as f:
            for b in json.load(f)["benchmarks"]:
                scale = {"ns": 1.0, "us": 1e3, "ms": 1e6, "s": 1e9}[b.get("time_unit", "ns")]
                name = b.get("run_name", b["name"])
                if b.get("run_type", "iteration") == "iteration":
                    times[name] = b["cpu_time"] * scale
                elif b.get("aggregate_name") == "median":
                    medians[name] = b["cpu_time"] * scale
    times.update(medians)
    return times


def main():
    times = load(sys.argv[1:])
    paired = sorted(n[3:] for n in times if n.startswith("QD/") and "Qt/" + n[3:] in times)
    print("| case | QuickDraw (ns) | raw Qt (ns) | ratio |")
    print("|---|---:|---:|---:|")
    for case in paired:
        qd, qt = times["QD/" + case], times["Qt/" + case]
        print(f"| {case} | {qd:.1f} | {qt:.1f} | {qd / qt:.2f}x |")
    alone = sorted(n for n in times if not (n.startswith("QD/") and n[3:] in paired)
                   and not (n.startswith("Qt/") and n[3:] in paired))
    if alone:
        print()
        print("| benchmark | time (ns) | per second |")
        print("|---|---:|---:|")
        for n in alone:
            print(f"| {n} | {times[n]:.1f} | {1e9 / times[n]:,.0f} |")


if __name__ == "__main__":
    main()
