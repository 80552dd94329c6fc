# SPDX-License-Identifier: Apache-2.0
"""The rows for programs, and the machine that they are of."""

import json
import os
import platform
import re
import subprocess

VERSIONS = (["mpv", "--version"], ["ffmpeg", "-version"], ["ffmpegthumbnailer", "-v"])


def machine(java):
    """What the figures depend on besides the code."""
    return {"processor": _processor(), "processors": os.cpu_count(),
            "system": platform.freedesktop_os_release().get("PRETTY_NAME", platform.system()),
            "kernel": platform.release(),
            "versions": [line for line in map(_first_line, [*VERSIONS, [java, "--version"]])
                         if line]}


def machine_text(machine_facts, rounds, load):
    plural = "" if rounds == 1 else "s"
    busy = load[0] / machine_facts["processors"]
    return (f"{machine_facts['processors']} x {machine_facts['processor']},"
            f" {machine_facts['system']}; {rounds} round{plural}, medians (least to most);"
            f" load {load[0]:.1f} before and {load[1]:.1f} after"
            + ("; the machine was busy with other work" if busy > 0.5 else ""))


def content(rows, machine_facts, rounds, load):
    return {"machine": machine_facts, "rounds": rounds,
            "load": {"before": load[0], "after": load[1]},
            "rows": [_row(row) for row in rows]}


def write_json(path, value):
    write_whole(path, json.dumps(value, indent=2, ensure_ascii=False) + "\n")


def write_whole(path, text):
    """The file appears whole or not at all."""
    draft = f"{path}.part"
    try:
        with open(draft, "w", encoding="utf-8") as file:
            file.write(text)
        os.replace(draft, path)
    finally:
        if os.path.exists(draft):
            os.remove(draft)


def _row(row):
    goal = {"most": row.goal.most, "kind": row.goal.kind} if row.goal else None
    return {"row": row.name, "unit": row.unit, "here": _figure(row.here),
            "peer": {"name": row.peer_name, **_figure(row.peer)} if row.peer else None,
            "ratio": row.ratio, "goal": goal, "met": row.is_met, "failure": row.failure}


def _figure(figure):
    if figure is None:
        return None
    return {"median": figure.median, "least": figure.least, "most": figure.most,
            "samples": list(figure.samples)}


def _processor():
    with open("/proc/cpuinfo", encoding="utf-8") as file:
        name = re.search(r"^model name\s*: (.*)$", file.read(), re.MULTILINE)
    return name[1] if name else platform.machine()


def _first_line(command):
    try:
        done = subprocess.run(command, capture_output=True, text=True, check=False)
    except OSError:
        return None
    return (done.stdout + done.stderr).partition("\n")[0].strip()
