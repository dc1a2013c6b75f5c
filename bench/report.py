"""Turns the benchmarks' results into docs/bench.md and docs/bench.svg: report.py <folder of results> <docs>."""

import datetime
import json
import pathlib
import re
import subprocess
import sys

results, docs = map(pathlib.Path, sys.argv[1:])
COMPILERS = {"gcc": "g++", "clang": "clang"}
MESHES = (64, 96, 128, 192, 256)
GRIDS = ("45x80", "90x160", "180x320")


def load(pattern):
    """The shortest time of each benchmark in microseconds, because other programs only add time, and the counters."""
    times, counters = {}, {}
    for path in sorted(results.glob(pattern)):
        for run in json.loads(path.read_text())["benchmarks"]:
            if run.get("error_occurred"):
                sys.exit(f"{run['name']}: {run['error_message']}")
            if run["run_type"] == "iteration":
                name = run["run_name"]
                time = run["real_time" if name.endswith("real_time") else "cpu_time"]
                if time < times.get(name, float("inf")):
                    times[name] = time
                    counters[name] = run
    return times, counters


fastest, counters = {}, {}
for compiler in COMPILERS:
    fastest[compiler], counters[compiler] = load(f"{compiler}-*.json")
driver, driver_runs = load("driver.json")


def ratio(numerator, denominator):
    return [fastest[c][numerator] / fastest[c][denominator] for c in COMPILERS]


def against(what, other):
    return ratio(f"{what}/{other}", f"{what}/library")


rows = []  # description, goal, values of both compilers, the benchmark whose time is shown


def faster(what, than, label, wanted=None):
    rows.append((f"{what.replace('/', ', ')} against {label}", (">=", wanted), against(what, than), f"{what}/library"))


def dearer(text, numerator, denominator, allowed):
    rows.append((text, ("<=", allowed), ratio(numerator, denominator), numerator))


for n, scalar in ((64, 2.3), (128, 2.7), (256, 2.7)):
    faster(f"wave step/{n}", "scalar", "scalar", scalar)
    faster(f"wave step/{n}", "-O3", "-O3", 1.15)
    faster(f"wave step/{n}", "eigen", "Eigen", 2.0)
    dearer(f"calm surface, {n}: every test run, against none", f"calm surface/{n}/tested", f"calm surface/{n}/untested", 1.15)
for n in (64, 128, 256):
    faster(f"ripple/{n}", "scalar", "scalar")
for grid in GRIDS[1:]:
    faster(f"ink frame/{grid}", "scalar", "scalar", 3.85)
    faster(f"drag frame/{grid}", "scalar", "scalar", 3.8)
    faster(f"ink frame/{grid}", "-O3", "-O3")
    faster(f"packing/{grid}", "scalar", "scalar", 12)
    faster(f"forcing/{grid}", "scalar", "scalar", 6)
    faster(f"velocity advection/{grid}", "scalar", "scalar", 2.2)
    faster(f"drag advection/{grid}", "scalar", "scalar")
    faster(f"pressure solve/{grid}", "scalar", "scalar", 2.6)
    faster(f"pressure solve/{grid}", "eigen", "Eigen", 2.5)
    faster(f"divergence/{grid}", "scalar", "scalar")
    faster(f"gradient/{grid}", "scalar", "scalar")
for step in (2000, 10000, 30000):
    dearer(f"surface at step {step} against step 100", f"aged surface/128/{step}", "aged surface/128/100", 1.08)
for frame in (500, 1000, 2000, 3000):
    dearer(f"ink at frame {frame} against frame 10", f"aged ink/90x160/{frame}", "aged ink/90x160/10", 1.08)
for heights, allowed in (("mesh heights/128", 1.9), ("breezy heights/128", 2.45), ("mesh heights/256", 5.6)):
    dearer(f"{heights.replace('/', ', ')} against a wave step", heights, "wave step/128/library", allowed)
frame = "frame/fast drag/128/1080x1920"
apart = fastest["gcc"][frame] / fastest["clang"][frame]
rows.append(("whole frame of a fast drag: slower against faster compiler", ("<=", 1.1), [max(apart, 1 / apart)] * 2, frame))


def met(limit, values):
    sign, bound = limit
    return bound is None or all(v >= bound if sign == ">=" else v <= bound for v in values)


commit = subprocess.run(["git", "describe", "--always", "--dirty"], capture_output=True, text=True).stdout.strip()
cpu = re.search(r"model name\s*: (.*)", pathlib.Path("/proc/cpuinfo").read_text())
machine = cpu.group(1) if cpu else "an unnamed processor"


def both(name):
    return " / ".join(f"{fastest[c][name]:.3g}" for c in COMPILERS) + " µs"


def times_faster(what):
    return " / ".join(f"{v:.1f}" for v in against(what, "scalar")) + " times as fast as plain loops"


def started(scene):
    name = f"start/{scene}/real_time"
    parts = ", ".join(f"{part} {driver_runs[name][part]:.0f}" for part in ("context", "programs", "pictures", "frame"))
    return f"{driver[name] / 1000:.0f} ms ({parts})"


def drawn(scene):
    return f"{driver[f'driver/{scene}/real_time'] / 1000:.0f} ms with the driver"


summary = (
    ("Step of the waves, 128 × 128 points", both("wave step/128/library"), times_faster("wave step/128")),
    ("Step of the ink, 1080 × 1920", both("ink frame/90x160/library"), times_faster("ink frame/90x160")),
    (
        "Heights of a mesh of 128 vertices a side",
        both("mesh heights/128"),
        f"{both('breezy heights/128')} with a breeze, {both('mesh heights/256')} for 256 vertices a side",
    ),
    ("Whole frame of water, 1080 × 1920", both("frame/water/128/1080x1920"), drawn("water")),
    ("Whole frame of water and ink, fast drag", both(frame), drawn("fast drag")),
    ("Start, from no context to the first frame, 1080 × 1920", f"water {started('water')}", f"ink {started('ink')}"),
)

lines = [
    "# Benchmarks",
    "",
    "The processor's time for the waves, the ink, the mesh and whole frames, and the time until the first frame. One core of",
    f"{machine} computed it, with the baseline instruction set (no `-march`) and both compilers: g++ / clang. Each value is the",
    "fastest of 42 repetitions in random order, with the driver of 3. The *driver* is Mesa's, which also draws on the CPU",
    f"({driver_runs['driver/water/real_time']['label']}). Frames with a GL that only counts its calls show the CPU time alone.",
    "",
    "| what | time | |",
    "|---|---|---|",
]
lines += [f"| {what} | {time} | {note} |" for what, time, note in summary]
lines += [
    "",
    "The pictures of the start are decoded before. The first frame includes the translation of the shaders by the driver. In a",
    "process that has had a context before, the driver is loaded already.",
    "",
    f"Written by `scripts/bench.sh` on {datetime.date.today()} at commit {commit}.",
    "",
    "![Times faster than plain scalar loops](bench.svg)",
    "",
    "<details><summary>Ratios and their goals</summary>",
    "",
    "*Scalar* is the same formula as a plain loop at `-O2` without automatic vectorization, *-O3* the same loop with it, and",
    "*Eigen* the same formula as array expressions. \"A against B\" is the time of B / the time of A for kernels, and A / B for",
    "surfaces, heights, ink and frames. A bold ratio misses its goal. Sizes are vertices per side of the water's mesh, and",
    "texels of the ink's grid. The ink's field is noise of ±20 cells a step; a *drag* frame or advection moves the field of a",
    "fast drag after one second.",
    "",
    "| what | goal | g++ | clang | time, g++ |",
    "|---|---|---|---|---|",
]
for what, limit, values, timed in rows:
    sign, bound = limit
    goal = "" if bound is None else f"{'at least' if sign == '>=' else 'at most'} {bound}"
    cells = [f"{v:.2f}" if met(limit, [v]) else f"**{v:.2f}**" for v in values]
    lines.append(f"| {what} | {goal} | {cells[0]} | {cells[1]} | {fastest['gcc'][timed]:.3g} µs |")

lines += [
    "",
    "</details>",
    "",
    "<details><summary>Whole frames</summary>",
    "",
    "Whole frames of the host, with the vertices per side of the mesh and the size of the view. The CPU time is",
    "measured with a GL that only counts its calls. The last column is a whole frame with the driver.",
    "",
    "| frame | CPU, g++ | CPU, clang | GL calls | uploaded | allocations | with the driver |",
    "|---|---|---|---|---|---|---|",
]
frames = [f"frame/{scene}/128/1080x1920" for scene in ("water", "idle ink", "fast drag")]
frames += [f"frame/water/{n}/1080x1920" for n in MESHES if n != 128]
frames += [f"frame/fast drag/128/{view}" for view in ("540x960", "2160x3840")]
for name in frames:
    _, scene, mesh, view = name.split("/")
    run = counters["gcc"][name]
    with_driver = drawn(scene).split(" with")[0] if (mesh, view) == ("128", "1080x1920") else ""
    lines.append(
        f"| {scene}, {mesh}, {view} | {fastest['gcc'][name]:.0f} µs | {fastest['clang'][name]:.0f} µs "
        f"| {run['calls']:.0f} | {run['bytes'] / 1024:.0f} KiB | {run['allocations']:g} "
        f"| {with_driver} |"
    )

lines += [
    "",
    "</details>",
    "",
    "<details><summary>Scaling</summary>",
    "",
    "Nanoseconds per vertex or texel, with g++. A row is constant if the time grows linearly. A whole frame computes",
    "its waves on a lattice of 128 per side for any mesh, and only the visible part of the mesh.",
    "",
]
lines += [f"| | {' | '.join(map(str, MESHES))} |", "|---|" + "---|" * len(MESHES)]
for text, pattern in (
    ("wave step", "wave step/{}/library"),
    ("heights of the mesh", "mesh heights/{}"),
    ("heights with a breeze", "breezy heights/{}"),
    ("whole water frame", "frame/water/{}/1080x1920"),
):
    cells = [f"{fastest['gcc'][pattern.format(n)] * 1000 / n**2:.2f}" for n in MESHES]
    lines.append(f"| {text} | {' | '.join(cells)} |")
lines += ["", f"| | {' | '.join(GRIDS)} |", "|---|" + "---|" * len(GRIDS)]
cells = [f"{fastest['gcc'][f'ink frame/{g}/library'] * 1000 / counters['gcc'][f'ink frame/{g}/library']['items']:.2f}" for g in GRIDS]
lines.append(f"| ink frame | {' | '.join(cells)} |")
lines += ["", "</details>"]
(docs / "bench.md").write_text("\n".join(lines) + "\n")

bars = [(f"wave step, {n}", f"wave step/{n}") for n in (64, 128, 256)]
bars += [(f"{k}, 90x160", f"{k}/90x160") for k in ("velocity advection", "divergence", "pressure solve", "gradient", "forcing", "packing", "ink frame")]
scale, left, step = 34, 205, 44
height = step * len(bars) + 70
svg = [
    f'<svg xmlns="http://www.w3.org/2000/svg" width="800" height="{height}" font-family="sans-serif" font-size="14">',
    f'<rect width="800" height="{height}" fill="white"/>',
    '<text x="20" y="28" font-size="17">Times faster than the same formula in plain scalar loops</text>',
]
colors = {"gcc": "#1f6f8b", "clang": "#8fc1d4"}
for i, (text, what) in enumerate(bars):
    y = 48 + i * step
    svg.append(f'<text x="{left - 10}" y="{y + 20}" text-anchor="end">{text}</text>')
    for k, (compiler, value) in enumerate(zip(COMPILERS, against(what, "scalar"))):
        svg.append(f'<rect x="{left}" y="{y + 17 * k}" width="{value * scale:.0f}" height="15" fill="{colors[compiler]}"/>')
        svg.append(f'<text x="{left + value * scale + 6:.0f}" y="{y + 17 * k + 12}" font-size="12">{value:.1f} {COMPILERS[compiler]}</text>')
svg.append(f'<line x1="{left + scale}" y1="42" x2="{left + scale}" y2="{height - 30}" stroke="#444" stroke-dasharray="4 3"/>')
svg.append(f'<text x="20" y="{height - 10}" font-size="12" fill="#444">{machine}, one core</text>')
(docs / "bench.svg").write_text("\n".join(svg + ["</svg>"]) + "\n")

for what, limit, values, _ in rows:
    if not met(limit, values):
        print(f"missed: {what}: wanted {limit[1]}, " + ", ".join(f"{n} {v:.2f}" for n, v in zip(COMPILERS.values(), values)))
