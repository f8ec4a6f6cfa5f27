#!/usr/bin/env python3
"""Compiles every code block of the host guide against the interface headers alone, and runs the whole
host of it: guide_test.py COMPILER LIBRARY SOURCE_DIRECTORY."""
import pathlib
import re
import subprocess
import sys
import tempfile

PREAMBLE = """#include <cstdio>
#include <memory>
#include "model/host/i_column.h"
#include "model/host/i_data_provider.h"
#include "model/host/i_finders.h"
#include "model/host/i_string.h"
#include "model/host/i_variable_format.h"
"""


def unit(block):
    if "int main" in block:
        return block
    if block.startswith("class"):
        return PREAMBLE + block
    return PREAMBLE + "void fragment(dp::IDataProvider* provider) {\n" + block + "}\n"


def main(compiler, library, source):
    blocks = re.findall(r"^```cpp\n(.*?)^```", (pathlib.Path(source) / "docs/host-guide.md").read_text(), re.M | re.S)
    assert len(blocks) >= 6, "the guide has lost its code"
    with tempfile.TemporaryDirectory() as directory:
        for number, block in enumerate(blocks):
            code = pathlib.Path(directory) / f"block{number}.cpp"
            code.write_text(unit(block))
            whole = ["-ldl", "-o", f"{directory}/host"] if "int main" in block else ["-c", "-o", "/dev/null"]
            subprocess.run([compiler, "-std=c++17", "-Wall", "-Wextra", "-Werror", "-I", source, code] + whole,
                           check=True)
        shown = subprocess.run([f"{directory}/host", library, f"{source}/samples/sample.xlsx"], check=True,
                               capture_output=True, text=True).stdout.splitlines()
        assert len(shown) > 3 and all(re.fullmatch(r".*: \d+ rows, \d+ missing", line) for line in shown), shown
        broken = pathlib.Path(directory) / "broken.xlsx"
        broken.write_text("no package")
        assert subprocess.run([f"{directory}/host", library, broken]).returncode == 1


if __name__ == "__main__":
    main(*sys.argv[1:])
