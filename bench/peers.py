#!/usr/bin/env python3
"""The measurements of peers.sh, and its table.

usage: peers.py time COMMAND...            milliseconds until the command ends
       peers.py memory COMMAND...          kilobytes: VmHWM of every process of the prefix that it starts, added up
       peers.py window SCREEN COMMAND...   milliseconds until something is on the screen; what was started is then ended
       peers.py report RESULTS [DOCUMENT]  prints the table, puts it into the document, judges the bounds (exit code)

SCREEN is the frame buffer file of Xvfb. RESULTS has a line "PROGRAM MEASURE NUMBER" for each measurement, and lines
"about TEXT", which stand above the table.
"""

import os
import re
import signal
import statistics
import subprocess
import sys
import time

SILENT = {"stdout": subprocess.DEVNULL, "stderr": subprocess.DEVNULL}
MANY_ROWS = 30  # of the screen: less than any window, more than a pointer


def processes():
    """Those of the Wine prefix, but for Wine's own server."""
    wanted = ("WINEPREFIX=" + os.environ["WINEPREFIX"]).encode()
    found = set()
    for name in filter(str.isdigit, os.listdir("/proc")):
        try:
            with open(f"/proc/{name}/environ", "rb") as file:
                ours = wanted in file.read().split(b"\0")
            with open(f"/proc/{name}/comm") as file:
                if ours and not file.read().startswith(("wineserver", "python3")):
                    found.add(int(name))
        except OSError:
            pass  # it has ended
    return found


def peak_kilobytes(pid):
    try:
        with open(f"/proc/{pid}/status") as file:
            return int(re.search(r"VmHWM:\s*(\d+)", file.read()).group(1))
    except (OSError, AttributeError):
        return 0


def elapsed(start):
    return round((time.monotonic() - start) * 1000)


def measure_time(command):
    start = time.monotonic()
    code = subprocess.run(command, **SILENT).returncode
    milliseconds = elapsed(start)
    if code:
        sys.exit(f"exit code {code}: {command}")
    return milliseconds


def measure_memory(command):
    before = processes()
    peaks = {}
    child = subprocess.Popen(command, **SILENT)
    while child.poll() is None:
        for pid in processes() - before:
            peaks[pid] = max(peaks.get(pid, 0), peak_kilobytes(pid))
        time.sleep(0.01)
    if child.returncode:
        sys.exit(f"exit code {child.returncode}: {command}")
    return sum(peaks.values())


def screen_rows(path):
    with open(path, "rb") as file:
        return file.read()


def changed_rows(a, b, stride=4096):
    return sum(a[i : i + stride] != b[i : i + stride] for i in range(0, len(a), stride))


def measure_window(screen, command):
    before = processes()
    empty = screen_rows(screen)
    start = time.monotonic()
    child = subprocess.Popen(command, **SILENT)
    while changed_rows(empty, screen_rows(screen)) < MANY_ROWS:
        if elapsed(start) > 20000 or child.poll() is not None:
            sys.exit(f"no window: {command}")
        time.sleep(0.002)
    milliseconds = elapsed(start)
    while started := processes() - before:
        for pid in started:
            try:
                os.kill(pid, signal.SIGKILL)
            except ProcessLookupError:
                pass
        child.poll()
        time.sleep(0.05)
    for _ in range(100):  # until the desktop is empty again, for the next
        if changed_rows(empty, screen_rows(screen)) == 0:
            break
        time.sleep(0.05)
    return milliseconds


# ---- the report

MEASURES = [
    ("time", "installation, ms", 1),
    ("size", "packed size, bytes", 1),
    ("memory", "peak memory, KB", 1),
    ("window", "first window, ms", 1),
    ("empty", "empty product, bytes", 1),
]
# what is bounded, ours against which program's, the factor
BOUNDS = [("time", "nsis", 0.55), ("time", "msi", 0.3), ("size", "nsis", 1.0), ("window", "nsis", 1.0)]
EMPTY_BOUND = 300 * 1024
MARKS = ("<!-- peers.sh writes from here -->", "<!-- to here -->")


def read_results(path):
    about, results = [], {}
    with open(path) as file:
        for line in file:
            program, _, rest = line.strip().partition(" ")
            if program == "about":
                about.append(rest)
            else:
                measure, number = rest.split()
                results.setdefault((program, measure), []).append(int(number))
    return about, results


def cell(results, program, measure):
    numbers = results.get((program, measure))
    if not numbers:
        return ""
    spread = f" ({min(numbers):,} to {max(numbers):,})" if max(numbers) > min(numbers) else ""
    return f"{round(statistics.median(numbers)):,}{spread}"


def judge(results):
    lines, kept = [], True
    for measure, other, factor in BOUNDS:
        ours = statistics.median(results["orbit", measure])
        ratio = ours / statistics.median(results[other, measure])
        kept = kept and ratio <= factor
        lines.append((f"{measure}, orbit / {other}", f"{ratio:.2f}", f"{factor}", ratio <= factor))
    empty = results["orbit", "empty"][0]
    lines.append(("empty product, bytes", f"{empty:,}", f"{EMPTY_BOUND:,}", empty <= EMPTY_BOUND))
    rows = [f"| {what} | {value} | {bound} | {'kept' if good else 'MISSED'} |" for what, value, bound, good in lines]
    return rows, kept and empty <= EMPTY_BOUND


def report(results_path, document=None):
    about, results = read_results(results_path)
    rows, kept = judge(results)
    lines = [f"- {line}" for line in about]
    lines += ["", "| median (least to most) | orbit | NSIS | MSI |", "|---|---|---|---|"]
    for measure, title, _ in MEASURES:
        lines.append(f"| {title} | " + " | ".join(cell(results, p, measure) for p in ("orbit", "nsis", "msi")) + " |")
    lines += ["", "| bound | measured | at most | |", "|---|---|---|---|"] + rows
    text = "\n".join(lines)
    print(text)
    if document:
        with open(document) as file:
            whole = file.read()
        start, end = (whole.index(mark) for mark in MARKS)
        with open(document, "w") as file:
            file.write(f"{whole[:start]}{MARKS[0]}\n\n{text}\n\n{whole[end:]}")
    sys.exit(0 if kept else 1)


verb, arguments = sys.argv[1], sys.argv[2:]
if verb == "report":
    report(*arguments)
elif verb == "window":
    print(measure_window(arguments[0], arguments[1:]))
else:
    print({"time": measure_time, "memory": measure_memory}[verb](arguments))
