#!/usr/bin/env python3
"""Follows docs/many-workbooks.md with GNU parallel: stops its command in the middle and gives it again.
Usage: many_test.py DPXLSX SOURCE_FOLDER [FOLDER], by default with the workbooks of the tests."""

import csv
import os
import pathlib
import re
import shutil
import signal
import subprocess
import sys
import tempfile
import time

TOOL, SOURCE = (pathlib.Path(argument).resolve() for argument in sys.argv[1:3])
BOOKS = pathlib.Path(sys.argv[3] if sys.argv[3:] else SOURCE / "tests" / "data").resolve()
COMMANDS = re.findall(r"^```sh\n(find .*?parallel .*?)^```", (SOURCE / "docs" / "many-workbooks.md").read_text(),
                      re.M | re.S)


def files(folder):
    return {str(path.relative_to(folder)): path.read_bytes() for path in folder.rglob("*") if path.is_file()}


def follow(work, stop):
    """Runs the command of the page in `work`, gives it `stop` in the middle, and runs it again."""
    (work / "temporary").mkdir(parents=True)
    (work / "bin").mkdir()
    shutil.copytree(BOOKS, work / "books" / "more")
    tool = work / "bin" / "dpxlsx"  # slow enough to be stopped
    tool.write_text(f'#!/bin/sh\nsleep 0.1\nexec "{TOOL}" "$@"\n')
    tool.chmod(0o755)
    environment = {**os.environ, "PATH": f"{tool.parent}:{os.environ['PATH']}", "TMPDIR": str(work / "temporary"),
                   "HOME": str(work)}

    def start():
        return subprocess.Popen(COMMANDS[0], shell=True, cwd=work, env=environment, start_new_session=True,
                                stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)

    def log():
        jobs = work / "jobs.log"
        return list(csv.DictReader(jobs.read_text().splitlines(), delimiter="\t")) if jobs.exists() else []

    first = start()
    while len(log()) < 5:
        assert first.poll() is None, "the command ends early: is parallel installed?"
        time.sleep(0.05)
    os.killpg(first.pid, stop)
    first.wait()
    done = {job["Seq"] for job in log() if job["Exitval"] == "0" and job["Signal"] == "0"}
    assert done and len(done) < len(books), (stop, len(done))
    start().wait()
    return log(), done


books = sorted(BOOKS.glob("*.xlsx"))
assert len(COMMANDS) == 1 and len(books) > 10
with tempfile.TemporaryDirectory() as folder:
    wanted = pathlib.Path(folder) / "wanted"
    subprocess.run([TOOL, "--csv", f"{wanted}/", *books], check=False, stderr=subprocess.DEVNULL)
    for stop in (signal.SIGINT, signal.SIGKILL):
        work = pathlib.Path(folder) / stop.name
        jobs, done = follow(work, stop)
        endings = {seq: [job["Exitval"] for job in jobs if job["Seq"] == seq] for seq in {job["Seq"] for job in jobs}}
        assert len(endings) == len(books), "a workbook is lost"
        assert all(endings[seq] == ["0"] for seq in done), "a workbook is read twice"
        made = files(work / "out" / "books" / "more")
        if stop == signal.SIGKILL:  # may leave what was being written aside
            made = {name: content for name, content in made.items() if "/.dpxlsx-" not in name}
        assert made == files(wanted), (stop, set(made) ^ set(files(wanted)))
        if stop != signal.SIGKILL:
            left = [name for name in os.listdir(work / "temporary") if not name.endswith(".par")]
            assert not left, left  # the others are parallel's
