"""processes_test.py TOOL WORKBOOK: processes that import the same workbook at once do not affect
each other: each prints what a single one prints, and nothing is left in the temporary directory."""

import os
import subprocess
import sys
import tempfile

TOOL, WORKBOOK = sys.argv[1:]
PROCESSES, ROUNDS = 4, 10


def start(temporary):
    environment = dict(os.environ, TMPDIR=temporary)
    return subprocess.Popen([TOOL, WORKBOOK], env=environment, stdout=subprocess.PIPE,
                            stderr=subprocess.PIPE)


with tempfile.TemporaryDirectory() as temporary:
    alone = start(temporary).communicate()
    # The sample has a cell that does not fit its column and a text that is cut, which is noted.
    assert alone[0] and alone[1].count(b"\n") == 2 and b"became missing" in alone[1] \
        and b"was cut" in alone[1], alone
    for _ in range(ROUNDS):
        running = [start(temporary) for _ in range(PROCESSES)]
        for process in running:
            assert process.communicate() == alone and process.returncode == 0
    assert not os.listdir(temporary)
