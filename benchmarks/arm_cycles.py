"""Cycles a pixel of the row kernels' inner loops on ARM cores, as llvm-mca sees them."""

import pathlib
import re
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
CORES = ("cortex-a55", "cortex-a76")
INCLUDES = ("-I", str(ROOT))
COMPILERS = {
    "g++": ("aarch64-linux-gnu-g++",),
    "clang++": ("clang++-19", "--target=aarch64-linux-gnu"),
}
FLAGS = ("-std=c++17", "-O3", "-fPIC", "-ffp-contract=off", "-fno-exceptions", "-fno-rtti")

# Source, function, and the bytes that it stores for each pixel, by which the pixels of one turn of
# the loop are counted.
KERNELS = [
    ("render/row_kernels.cpp", "scalar::grey", 4),
    ("render/row_kernels.cpp", "scalar::colour_selection", 4),
    ("render/row_kernels.cpp", "scalar::invert_and_colour", 5),
    ("render/row_kernels.cpp", "scalar::invert", 1),
    ("render/row_kernels.cpp", "scalar::gather_pixels", 4),
    ("render/row_kernels.cpp", "scalar::gather_bytes", 1),
    ("render/row_kernels.cpp", "scalar::double_pixels", 4),
    ("render/row_kernels.cpp", "scalar::classify", 1),
    ("render/row_kernels.cpp", "scalar::outline", 1),
    ("render/row_kernels.cpp", "scalar::small_outline", 1),
]

VECTOR = re.compile(r"\b[vq]\d+\b")
REGISTER_BYTES = {"q": 16, "d": 8, "s": 4, "h": 2, "b": 1, "x": 8, "w": 4}


def run(*command, text=None):
    result = subprocess.run(command, input=text, stdout=subprocess.PIPE, stderr=subprocess.PIPE,
                            text=True)
    if result.returncode != 0:
        sys.exit(f"arm_cycles: '{' '.join(command)}' failed:\n{result.stderr}")
    return result.stdout


def functions(source, compiler):
    """Returns {name without arguments: lines} of a source's functions as assembly."""
    with tempfile.TemporaryDirectory() as folder:
        assembly = pathlib.Path(folder) / "source.s"
        run(*COMPILERS[compiler], *FLAGS, *INCLUDES, "-S", str(ROOT / source), "-o", str(assembly))
        text = assembly.read_text()
    found = {}
    for match in re.finditer(r"^(_Z\w+):(.*?)^\s*\.size\s+\1,", text, re.MULTILINE | re.DOTALL):
        name = run("c++filt", match[1]).split("(anonymous namespace)::")[-1].split("(")[0].strip()
        found[name] = [re.sub(r"\s*(//|;).*", "", line).strip() for line in match[2].splitlines()]
    return found


def is_instruction(line):
    return line and not line.startswith((".", "#")) and not line.endswith(":")


def innermost_loops(lines):
    """The stretches from a label to a branch back to it that hold no other such stretch."""
    labels = {line[:-1]: i for i, line in enumerate(lines) if line.endswith(":")}
    loops = []
    for end, line in enumerate(lines):
        branch = re.match(r"(?:b\.?\w*|cbn?z|tbn?z)\s+(?:.*,\s*)?(\.\w+)$", line)
        if branch and labels.get(branch[1], end) < end:
            loops.append((labels[branch[1]], end))
    return [lines[start:end + 1] for start, end in loops
            if not any((s, e) != (start, end) and start <= s and e <= end for s, e in loops)]


def stored_bytes(loop):
    """Bytes that one turn of a loop stores."""
    total = 0
    for line in loop:
        match = re.match(r"(st\w+)\s+(.*)", line)
        if not match:
            continue
        name, operands = match[1], match[2].split("[")[0] if "{" not in match[2] else match[2]
        vectors = re.match(r"\{\s*v(\d+)\.(\d*)([bhsd])(?:.*?-\s*v(\d+)|((?:,\s*v\d+[^,}]*)*))\s*.*?\}"
                           r"(\[\d+\])?", operands)
        if vectors:
            count = (int(vectors[4]) - int(vectors[1]) + 1 if vectors[4]
                     else 1 + (vectors[5] or "").count("v"))
            lanes = 1 if vectors[6] else int(vectors[2])
            total += count * lanes * REGISTER_BYTES[vectors[3]]
        elif name in ("strb", "sturb"):
            total += 1
        elif name in ("strh", "sturh"):
            total += 2
        else:
            registers = re.findall(r"\b([qdshbxw])(?:\d+|zr)\b", operands)
            total += sum(REGISTER_BYTES[r] for r in registers)
    return total


def hottest_loop(lines):
    """The innermost loop with the most vector instructions; the one that stores most among equals."""
    loops = [loop for loop in innermost_loops(lines) if stored_bytes(loop) > 0]
    return max(loops, default=None,
               key=lambda loop: (sum(bool(VECTOR.search(line)) for line in loop),
                                 stored_bytes(loop)))


def cycles(loop, core):
    """Cycles that one turn of a loop takes."""
    turns = 200
    # The labels stay, for the branches.
    text = "\n".join(line for line in loop if is_instruction(line) or line.endswith(":"))
    report = run("llvm-mca-19", "-mtriple=aarch64-linux-gnu", f"-mcpu={core}",
                 f"-iterations={turns}", text=text + "\n")
    return int(re.search(r"Total Cycles:\s+(\d+)", report)[1]) / turns


def table():
    """Rows: the heading, then a kernel each."""
    rows = [["kernel"] + [f"{core}, {compiler}" for core in CORES for compiler in COMPILERS]]
    assembly = {(source, compiler): functions(source, compiler)
                for source in {kernel[0] for kernel in KERNELS} for compiler in COMPILERS}
    for source, name, bytes_a_pixel in KERNELS:
        row = [name.split("::")[-1]]
        for core in CORES:
            for compiler in COMPILERS:
                lines = assembly[source, compiler].get(name)
                loop = hottest_loop(lines) if lines else None
                pixels = stored_bytes(loop) / bytes_a_pixel if loop else 0
                row.append(f"{cycles(loop, core) / pixels:.2f}" if loop else "-")
        rows.append(row)
    return rows
