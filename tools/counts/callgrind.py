# SPDX-License-Identifier: Apache-2.0
"""How many instructions the product executes on a path.

What counts, while the program is in its function orv_counted: the instructions
of the product's own file, and those that the C and C++ libraries execute when
it calls them (copies, allocations, locks). The fakes of the Java virtual machine
and of the engine are in the program's file and the platform's functions in files
of their own, and count nothing, though they run inside the same calls: only the
instructions that call them show. Nothing here depends on names of functions, nor
on what was inlined."""

import concurrent.futures
import os
import re
import subprocess
import tempfile

from refusal import Refusal

TIMES = 10
# Runs of valgrind at the same time; the test reserves as many processors.
PARALLEL = 2

# By the file that a call leads into; none of them calls back.
LIBRARY = re.compile(r"(libc|libm|libstdc\+\+|libgcc_s)\.so\.\d+$")

# What makes counts vary: the environment's size and the addresses, functions
# looked up at their first call, and the copying functions that the C library
# chooses by processor and size of its caches.
ENVIRONMENT = {
    "PATH": "/usr/bin:/bin",
    "LC_ALL": "C",
    "LD_BIND_NOW": "1",
    "GLIBC_TUNABLES": ":".join((
        "glibc.cpu.hwcaps=-AVX_Fast_Unaligned_Load,-AVX512VL,-AVX2,-SSE4_2,-SSE4_1,-SSSE3,-ERMS"
        ",-FSRM",
        *(f"glibc.cpu.x86_{threshold}_threshold=0x400000" for threshold in (
            "non_temporal", "memset_non_temporal", "rep_movsb", "rep_stosb")))),
}

VALGRIND = ["valgrind", "--tool=callgrind", "--quiet", "--toggle-collect=orv_counted",
            "--compress-pos=no", "--compress-strings=no"]


def count(profile, product):
    """The instructions of a profile that count; product is the file's path."""
    own = inside = False
    total = 0
    is_call = False
    callee = None
    if not re.search(r"^events: Ir$", profile, re.MULTILINE):
        raise Refusal("callgrind wrote no instruction counts")
    for line in profile.splitlines():
        key, _, value = line.partition("=")
        if key == "ob":
            own = value == product
            inside = inside or own
        elif key == "cob":
            callee = value
        elif key == "calls":
            is_call = True
        elif line[:1].isdigit():
            counts = own and (not is_call or LIBRARY.search(callee or product))
            total += int(line.split()[1]) if counts else 0
            is_call, callee = False, None
    if not inside:
        raise Refusal(f"nothing of {product} was executed")
    return total


def output_of(command, **options):
    """What a program writes that succeeds."""
    try:
        done = subprocess.run(command, capture_output=True, text=True, **options)
    except FileNotFoundError:
        raise Refusal(f"{command[0]} is not installed") from None
    except OSError as error:
        raise Refusal(f"{command[0]}: {error.strerror}") from None
    if done.returncode != 0:
        said = (done.stderr + done.stdout).strip().splitlines()
        raise Refusal(f"{' '.join(command)} failed: {said[-1] if said else done.returncode}")
    return done.stdout


def profile_of(command):
    """What callgrind writes about a program."""
    with tempfile.TemporaryDirectory() as folder:
        out = os.path.join(folder, "profile")
        output_of([*VALGRIND, f"--callgrind-out-file={out}", *command], env=ENVIRONMENT, cwd=folder)
        with open(out, encoding="utf-8", errors="replace") as file:
            return file.read()


def rows_of(counts):
    """The table's rows of the paths' counts for TIMES runs: NAME/10 and NAME/0
    are one row, a tenth of their difference."""
    rows = {}
    for path, instructions in counts.items():
        name, _, entries = path.partition("/")
        if entries == "10":
            if f"{name}/0" not in counts:
                raise Refusal(f"{path} has no {name}/0 beside it")
            rows[name] = round((instructions - counts[f"{name}/0"]) / 10 / TIMES)
        elif not entries:
            rows[name] = round(instructions / TIMES)
    return rows


def measure(program, product):
    """{row: instructions} of all paths of the program, a run of valgrind each."""
    product = os.path.realpath(product)
    program = os.path.realpath(program)
    paths = output_of([program]).split()

    def count_path(path):
        return count(profile_of([program, path, str(TIMES)]), product)

    with concurrent.futures.ThreadPoolExecutor(PARALLEL) as pool:
        return rows_of(dict(zip(paths, pool.map(count_path, paths))))
