#!/usr/bin/env python3
"""Times the library beside plain versions, peers and the machine's floor, and prints one table.

Each job runs in a process of its own, pinned to one core, its variants in random turns. --update
writes RESULTS.md and the growth plots from what was measured; ./dev bench calls this.
"""

import argparse
import json
import os
import pathlib
import platform
import re
import shlex
import subprocess
import sys
import time

sys.dont_write_bytecode = True
import arm_cycles  # noqa: E402

HERE = pathlib.Path(__file__).resolve().parent
ROOT = HERE.parent
PHOTO_SIZE = (4000, 3000)
GROWTH_PNG = HERE / "growth_regions.png"
RADIUS_PNG = HERE / "growth_radius.png"

OUR_OWN = ("ours", "plain", "floor")  # variants that are no peers

# What is to be reached: jobs, the most that ours may take, and of what: the fastest peer ("peer"), one
# of the variants, or "second".
AIMS = [
    (r"grey copy", 1.0, "peer"),
    (r"grey copy, 256 x 256", 0.6, "peer"),
    (r"selection in colour, rest grey", 0.7, "peer"),
    (r"selection in colour, mask inverted", 0.5, "peer"),
    (r"draw at (0\.25|0\.5|1|1\.7|4)", 1.0, "peer"),
    (r"draw at 0\.25, small view", 0.6, "peer"),
    (r"draw at 2\.7", 0.85, "pixman"),
    (r"draw with outline at 0\.25", 0.5, "peer"),
    (r"draw with outline at 1", 0.65, "peer"),
    (r"draw with outline at 1\.7", 0.7, "peer"),
    (r"draw with outline at 2\.7", 0.9, "peer"),
    (r"fill holes, (0|100|1000) specks", 0.5, "peer"),
    (r"keep the largest, (0|100) specks", 0.95, "peer"),
    (r"keep the largest, 1000 specks", 0.6, "peer"),
    (r"lasso fill, radius 1000", 0.12, "plain"),
    (r"lasso fill, radius 50", 0.02, "plain"),
    (r"object box", 0.8, "peer"),
    (r"inversion with box", 1.0, "peer"),
    (r"(grow|shrink), r = \d+", 1.0, "peer"),
    (r"(fill holes|keep the largest), noise", 1.0, "second"),
]
FLATNESS_AIM = 1.3  # of the nanoseconds a cell, over all radii

LEFT_OUT_OF_QUICK = r"000 specks|noise$"

HEADINGS = ["job", "ours", "plain", "fastest peer", "floor", "ours / plain", "ours / peer", "aim",
            "met"]


# --- measuring -----------------------------------------------------------------------------------

def make_photo(path):
    """Writes the photo: the fig at its own size, and mirrored around until 12 megapixels are full."""
    from PIL import Image, ImageOps
    fig = Image.open(ROOT / "desktop/photos/fig.jpg").convert("RGBA")
    photo = Image.new("RGBA", PHOTO_SIZE)
    for row, top in enumerate(range(0, PHOTO_SIZE[1], fig.height)):
        for column, left in enumerate(range(0, PHOTO_SIZE[0], fig.width)):
            tile = ImageOps.mirror(fig) if column % 2 else fig
            photo.paste(ImageOps.flip(tile) if row % 2 else tile, (left, top))
    path.write_bytes(photo.tobytes("raw", "BGRA"))


class Variant:
    def __init__(self):
        self.times = []      # nanoseconds a run
        self.differs = None  # share of its result that differs from the plain one
        self.cells = 0
        self.error = None


class Job:
    """The variants of a job: {name: Variant}. Times are the least of the repetitions."""

    def __init__(self, name, entries):
        self.name = name
        self.variants = {}
        for entry in entries:
            if entry.get("run_type") == "aggregate":
                continue
            words = entry["name"][len(name) + 1:].split("/")
            variant = self.variants.setdefault(words[0], Variant())
            if entry.get("error_occurred"):
                variant.error = entry["error_message"]
                continue
            time_field = "real_time" if "manual_time" in words else "cpu_time"
            variant.times.append(entry[time_field])
            variant.differs = entry.get("differs")
            variant.cells = entry.get("cells", 0)

    def time(self, variant):
        v = self.variants.get(variant)
        return min(v.times) if v and v.times else None

    def peers(self):
        return {name: v for name, v in self.variants.items() if name not in OUR_OWN}

    def fastest_peer(self):
        return min(self.peers(), key=self.time, default=None)

    def ratio(self, other):
        ours, theirs = self.time("ours"), self.time(other)
        return ours / theirs if ours and theirs else None

    def aim(self):
        """Returns (limit, of what), or None."""
        for pattern, limit, against in AIMS:
            if re.fullmatch(pattern, self.name):
                return limit, against
        return None

    def reached(self):
        """What the aim limits, or None where it was not measured."""
        against = self.aim()[1]
        if against == "second":
            return self.time("ours") and self.time("ours") / 1e9
        return self.ratio(self.fastest_peer() if against == "peer" else against)

    def cells(self):
        return self.variants["ours"].cells


def run_job(args, name):
    command = ["taskset", "-c", str(args.core), str(args.program), f"--photo={args.photo}",
               f"--job={name}", "--benchmark_format=json",
               f"--benchmark_repetitions={args.repetitions}",
               "--benchmark_enable_random_interleaving=true",
               f"--benchmark_min_time={args.min_time}"]
    result = subprocess.run(command, stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
    if result.returncode != 0:
        sys.exit(f"\nreport: '{shlex.join(command)}' failed:\n{result.stderr}")
    job = Job(name, json.loads(result.stdout)["benchmarks"])
    if not job.time("ours"):
        sys.exit(f"\nreport: '{shlex.join(command)}' did not time the library:\n{result.stderr}")
    return job


def measure(args):
    names = subprocess.run([args.program, "--list"], stdout=subprocess.PIPE, text=True,
                           check=True).stdout.splitlines()
    names = [n for n in names if re.search(args.filter, n)]
    if args.quick:
        names = [n for n in names if not re.search(LEFT_OUT_OF_QUICK, n)]
    if not names:
        sys.exit(f"report: no job matches '{args.filter}'")
    jobs = []
    for i, name in enumerate(names):
        print(f"[{i + 1}/{len(names)}] {name} ...", end=" ", flush=True)
        start = time.monotonic()
        jobs.append(run_job(args, name))
        print(f"{cell_time(jobs[-1], 'ours')} ({time.monotonic() - start:.1f} s)", flush=True)
    return jobs


# --- the table -----------------------------------------------------------------------------------

def text_of_time(nanoseconds):
    for unit, size in (("s", 1e9), ("ms", 1e6), ("µs", 1e3), ("ns", 1)):
        if nanoseconds >= size or unit == "ns":
            value = nanoseconds / size
            return f"{value:.{0 if value >= 100 else 1 if value >= 10 else 2}f} {unit}"
    raise AssertionError


def cell_time(job, variant):
    v = job.variants.get(variant)
    if v is None:
        return "-"
    if v.error:
        return v.error
    nanoseconds = job.time(variant)
    if v.cells:
        return f"{nanoseconds / v.cells:.{1 if nanoseconds >= 10 * v.cells else 2}f} ns a cell"
    return text_of_time(nanoseconds)


def text_of_ratio(ratio):
    if ratio is None:
        return "-"
    return f"{ratio:.{3 if ratio < 0.1 else 2 if ratio < 10 else 0}f}"


def table_rows(jobs):
    rows = []
    for job in jobs:
        peer = job.fastest_peer()
        aim, met, limit = job.aim(), "", ""
        if aim:
            limit = f"{aim[0]:g}" + ("" if aim[1] == "peer" else
                                     " s" if aim[1] == "second" else f" of {aim[1]}")
            reached = job.reached()
            met = "-" if reached is None else "yes" if reached <= aim[0] else "no"
            if aim[1] not in ("peer", "plain", "second", peer) and reached is not None:
                met += f" ({text_of_ratio(reached)})"
        rows.append([job.name, cell_time(job, "ours"), cell_time(job, "plain"),
                     f"{peer} {cell_time(job, peer)}" if peer else "-", cell_time(job, "floor"),
                     text_of_ratio(job.ratio("plain")), text_of_ratio(job.ratio(peer)), limit, met])
    return rows


def flatness(jobs):
    """Lines about how the time a cell depends on the brush's radius."""
    lines = []
    for way in ("grow", "shrink"):
        per_cell = [job.time("ours") / job.cells() for job in jobs
                    if re.fullmatch(rf"{way}, r = \d+", job.name)]
        if len(per_cell) > 1:
            spread = max(per_cell) / min(per_cell)
            lines.append(f"{way}: the dearest cell of all radii takes {spread:.2f} times the "
                         f"cheapest (aim {FLATNESS_AIM}: "
                         f"{'met' if spread <= FLATNESS_AIM else 'not met'})")
    return lines


def summary_of_aims(jobs):
    reached = [(job.reached(), job.aim()[0]) for job in jobs if job.aim()]
    met = sum(value is not None and value <= limit for value, limit in reached)
    return f"{met} of {len(reached)} aims met"


def print_table(jobs):
    rows = [HEADINGS] + table_rows(jobs)
    widths = [max(len(row[i]) for row in rows) for i in range(len(HEADINGS))]
    print()
    for row in rows:
        print("  ".join(cell.ljust(width) for cell, width in zip(row, widths)).rstrip())
    print()
    for line in flatness(jobs) + [summary_of_aims(jobs)]:
        print(line)


def markdown_table(rows):
    lines = ["| " + " | ".join(row) + " |" for row in rows]
    lines.insert(1, "|---" * len(rows[0]) + "|")
    return "\n".join(lines)


def text_of_difference(share):
    if share is None:
        return "not compared"
    if share == 0:
        return "equal"
    return "under 0.1 % differ" if share < 0.001 else f"{100 * share:.1f} % differ"


def peers_table(jobs):
    rows = [["job", "peers"]]
    for job in jobs:
        texts = [f"{name} {cell_time(job, name)} ({text_of_difference(job.peers()[name].differs)})"
                 for name in sorted(job.peers(), key=job.time)]
        if texts:
            rows.append([job.name, "; ".join(texts)])
    return markdown_table(rows)


# --- plots ---------------------------------------------------------------------------------------

def plot(path, draw, panels):
    """Draws each (title, jobs) into a panel with draw(axes, jobs)."""
    import matplotlib
    matplotlib.use("Agg")
    from matplotlib import pyplot
    figure, axes = pyplot.subplots(1, len(panels), figsize=(9, 3.8), sharey=True, squeeze=False)
    for ax, (title, jobs) in zip(axes[0], panels):
        ax.set_xscale("log")
        ax.set_yscale("log")
        draw(ax, jobs)
        ax.set_title(title, fontsize=10)
        ax.grid(True, which="major", alpha=0.3)
        ax.legend(fontsize=7)
    figure.tight_layout()
    figure.savefig(path, dpi=90, metadata={"Software": None})
    pyplot.close(figure)


# In the order of drawing: ours lies on top.
COLOURS = {"floor": "tab:green", "plain": "tab:gray", "peer": "tab:orange", "ours": "tab:blue"}


def times_of(job, who):
    """The variant meant by "ours", "plain", "peer" or "floor", and its time."""
    name = job.fastest_peer() if who == "peer" else who
    return job.time(name) if name else None


def draw_regions(ax, jobs):
    for where, style in (("scattered", "-"), ("on a diagonal", "--")):
        for who, colour in COLOURS.items():
            points = []
            for job in jobs:
                found = re.fullmatch(r".*, (\d+) specks?( on a diagonal)?", job.name)
                if bool(found[2]) == (where != "scattered") and times_of(job, who):
                    regions = int(found[1]) + (where == "scattered")  # the object is one, too
                    points.append((regions, times_of(job, who) / 1e6))
            if points and not (who == "floor" and style == "--"):
                label = {"peer": "fastest peer"}.get(who, who) + ", " + where
                ax.plot(*zip(*sorted(points)), style, color=colour, marker=".", label=label)
    ax.set_xlabel("regions in a mask of 12 megapixels")
    ax.set_ylabel("ms")


def draw_radius(ax, jobs):
    for who, colour in COLOURS.items():
        if who == "floor":  # far below
            continue
        points = [(int(job.name.split()[-1]), times_of(job, who) / job.cells()) for job in jobs
                  if times_of(job, who)]
        if points:
            label = next(iter(jobs[0].peers())) if who == "peer" else who
            ax.plot(*zip(*sorted(points)), color=colour, marker=".", label=label)
    radii = [int(job.name.split()[-1]) for job in jobs]
    ax.set_xlabel("brush radius")
    ax.set_ylabel("ns a cell")
    ax.set_xticks(radii, [str(r) for r in radii])
    times = (10, 20, 50, 100, 200, 400)
    ax.set_yticks(times, [str(t) for t in times])
    ax.minorticks_off()


def draw_plots(jobs):
    def panels(names, pattern):
        return [(name, [job for job in jobs if re.fullmatch(pattern.format(name), job.name)])
                for name in names]
    plot(GROWTH_PNG, draw_regions,
         panels(("fill holes", "keep the largest"), r"{}, \d+ specks?( on a diagonal)?"))
    plot(RADIUS_PNG, draw_radius, panels(("grow", "shrink"), r"{}, r = \d+"))


# --- RESULTS.md ----------------------------------------------------------------------------------

def output_of(*command):
    result = subprocess.run(command, cwd=ROOT, stdout=subprocess.PIPE, stderr=subprocess.DEVNULL,
                            text=True)
    return result.stdout.strip() if result.returncode == 0 else ""


def cpu_name():
    cpu_info = pathlib.Path("/proc/cpuinfo").read_text()
    names = re.findall(r"^(?:model name|Model)\s*:\s*(.*)$", cpu_info, re.MULTILINE)
    return f"{names[0] if names else platform.machine()}, {os.cpu_count()} cores"


def compiler_and_flags(build):
    commands = json.loads((build / "compile_commands.json").read_text())
    words = next(shlex.split(c["command"]) for c in commands
                 if c["file"].endswith("render/compositing.cpp"))
    flags = [w for w in words if re.match(r"-(O|f|m|std)", w)]
    return output_of(words[0], "--version").splitlines()[0] + ", `" + " ".join(flags) + "`"


def versions_of_peers():
    packages = ("libcairo2-dev", "libleptonica-dev", "libopencv-dev", "libpixman-1-dev",
                "libyuv-dev")
    texts = []
    for package in packages:
        version = output_of("dpkg-query", "-W", "-f", "${Version}", package)
        texts.append(f"{package} {version}" if version else package)
    return ", ".join(texts)


TEXT = """\
# Benchmarks

`{command}` wrote this file. Times are of one thread, pinned to one core: processor time, the
least of {repetitions} repetitions of {min_time} s or one run, whichever is longer. The ways to do a job take
turns at random within one process and share its buffers, so ratios hold better than times. Large blocks
of memory are used again from run to run.

|  |  |
|---|---|
| processor | {cpu} |
| compiler, flags | {compiler} |
| commit | {commit} |
| peers | {peers} |
| load of the machine before | {load} |

## How to read the table

- **ours** is what the library runs. **plain** is its definition: the simplest loops, which ours must equal
  bit for bit. Before a job is timed, ours is run once and compared with plain; a difference ends the
  whole run. Where plain takes 0.4 s or more, that one run is its time.
- **fastest peer** is the fastest of several general libraries with the same input, their memory laid out as
  they like it before the clock starts. They do the same work or less: their grey is a weighted sum, their
  outlines have one colour, their scales are rounded. What each took, and in how much of the result it
  differs from plain, stands further down.
- **floor** moves the same bytes without arithmetic: copies, reads, writes. Nothing can be much faster.
- **aim** is the most that ours may take of the fastest peer's time, or of what stands beside it.

The photo has 4000 x 3000 pixels, all real; the view has 1440 x 3088, the small one 1080 x 1920, and of it
as much is drawn as the photo covers at that scale. The mask holds an object with a smooth outline over a
third of the photo, with 40 holes where whole regions are worked on; specks of 3 to 12 pixels are scattered
around it or, without it, set on a diagonal. A stroke goes once around the fig in
[`desktop/photos/fig.jpg`](../desktop/photos/fig.jpg) with dabs half a radius apart, each on a fresh mask;
its times are divided by the cells of the brush.

## Results

{table}

{remarks}

## Growth

![Time of the passes on whole regions against the number of regions]({growth_png})

![Time a cell of the edge-aware strokes against the brush's radius]({radius_png})

## Each peer

{peers_table}

## llvm-mca

Cycles a pixel (or mask byte) of the row kernels' inner loops as `llvm-mca` sees them, memory that answers
at once: the loop with the most vector work of each function, compiled for AArch64 with `-O3`.

{arm_cycles}
"""


def write_results(args, jobs, commit, load):
    draw_plots(jobs)
    text = TEXT.format(
        command=args.shown_command, repetitions=args.repetitions, min_time=args.min_time,
        cpu=cpu_name(), compiler=compiler_and_flags(args.build),
        commit=commit, peers=versions_of_peers(), load=load,
        table=markdown_table([HEADINGS] + table_rows(jobs)),
        remarks="\n".join(f"- {line}" for line in flatness(jobs) + [summary_of_aims(jobs)]),
        growth_png=GROWTH_PNG.name, radius_png=RADIUS_PNG.name, peers_table=peers_table(jobs),
        arm_cycles=markdown_table(arm_cycles.table()))
    (HERE / "RESULTS.md").write_text(text)
    print(f"wrote {HERE.relative_to(ROOT)}/RESULTS.md, {GROWTH_PNG.name}, {RADIUS_PNG.name}")


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--build", type=pathlib.Path, default=ROOT / "build/bench",
                        help="folder of the preset 'bench'")
    parser.add_argument("--filter", default="", metavar="REGEX", help="jobs to run")
    parser.add_argument("--quick", action="store_true",
                        help="fewer repetitions, without the jobs that take seconds")
    parser.add_argument("--repetitions", type=int)
    parser.add_argument("--core", type=int, default=max(os.sched_getaffinity(0)),
                        help="core to run on; the last by default")
    parser.add_argument("--update", action="store_true", help="write RESULTS.md and the plots")
    parser.add_argument("--mca", action="store_true", help="print the llvm-mca table and nothing else")
    parser.add_argument("--no-peers", action="store_true", help="./dev builds without them")
    args = parser.parse_args()
    if args.update and (args.filter or args.quick or args.no_peers):
        parser.error("--update takes a whole run")
    if args.mca:
        for row in arm_cycles.table():
            print("  ".join(cell.ljust(22) for cell in row).rstrip())
        return
    args.repetitions = args.repetitions or (3 if args.quick else 9)
    args.min_time = 0.005 if args.quick else 0.02
    args.program = args.build / "benchmarks/benchmarks"
    args.photo = args.build / "photo.raw"
    args.shown_command = "./dev bench " + shlex.join(sys.argv[1:])
    if not args.photo.exists():
        make_photo(args.photo)
    commit = output_of("git", "describe", "--always", "--dirty") or "unknown"
    load = " ".join(f"{value:.2f}" for value in os.getloadavg())
    jobs = measure(args)
    print_table(jobs)
    if args.update:
        write_results(args, jobs, commit, load)


if __name__ == "__main__":
    main()
