#!/usr/bin/env python3
"""Uses the installed library as the engineer of a host would, with nothing but what is installed.

Usage: host_kit_test.py CMAKE BUILD_FOLDER SOURCE_FOLDER [TEST...]. BUILD_FOLDER may also be a folder
in which a package is unpacked: then its usr/ is taken instead of an installation.
"""

import multiprocessing.pool
import os
import pathlib
import re
import shlex
import shutil
import subprocess
import sys
import unittest

CMAKE = sys.argv.pop(1)
BUILD = pathlib.Path(sys.argv.pop(1)).resolve()
SOURCE = pathlib.Path(sys.argv.pop(1)).resolve()
SAMPLE = SOURCE / "samples" / "sample.xlsx"
COMPILERS = ("g++", "clang++")
STRICT = ["-Wall", "-Wextra", *(["-Werror"] if os.environ.get("CI") else [])]
WARNINGS = [*STRICT, "-Wpedantic"]
ROADS = """cmake_minimum_required(VERSION 3.16)
project(hosts CXX)
find_package(dpxlsx 1 CONFIG REQUIRED)
add_executable(minimal_host minimal_host.cpp)
target_link_libraries(minimal_host dpxlsx::dpxlsx)
add_executable(linked_host linked_host.cpp)
target_link_libraries(linked_host dpxlsx::dpxlsx)
"""

FRAGMENT = """#include <dlfcn.h>
#include <cstdio>
#include <dpxlsx/model/host/entry_points.h>
#include <dpxlsx/model/host/i_data_provider.h>
#include <dpxlsx/model/host/i_finders.h>
void fragment(dp::IDataProvider& provider);
void fragment([[maybe_unused]] dp::IDataProvider& provider) {
%s}
"""

README_HOST = """#include <dlfcn.h>
#include <cstdio>
%s
static void importWorksheet(dp::IDataProvider& provider, int key) {
    std::printf("%%d: %%u rows\\n", key, provider.GetWorksheetRowCount(static_cast<unsigned>(key)));
}
int main() {
%s}
"""

DATES = """#include "date_times.h"
int main() {
    HostDateTimes dates;
    const char* before = "";
    for (const char* text : {"1900-01-01", "1900-02-28", "1900-03-01", "1950-06-30", "2024-02-29",
                             "2024-02-31", "soon"}) {
        HostText given(text);
        double value = 0;
        const bool isDate = dates.ConvertToDatetime(nullptr, &given, value);
        std::unique_ptr<dp::IString> shown(dates.FormatValue(value, false));
        const std::string day(shown->database_str(), 10);
        std::printf("%s%s", before, isDate ? (day + " " + std::to_string(std::lround(value))).c_str() : "no");
        before = ", ";
    }
    std::unique_ptr<dp::IString> evening(dates.FormatValue(0.75, false));
    std::unique_ptr<dp::IString> noon(dates.FormatValue(1.5, false));
    std::printf("\\n%s %s\\n", evening->database_str() + 11, noon->database_str() + 11);
}
"""


def run(*command, expected=0, **options):
    done = subprocess.run([str(part) for part in command], capture_output=True, text=True,
                          errors="surrogateescape", check=False, timeout=300, **options)
    if done.returncode != expected:
        raise AssertionError(f"{command}: {done.returncode}\n{done.stdout}{done.stderr}")
    return done.stdout


class HostKitTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.work = BUILD / "host-kit"
        shutil.rmtree(cls.work, ignore_errors=True)
        cls.work.mkdir()
        cls.prefix = BUILD / "usr"
        if not cls.prefix.exists():
            cls.prefix = cls.work / "moved"
            run(CMAKE, "--install", BUILD, "--prefix", cls.work / "installed")
            (cls.work / "installed").rename(cls.prefix)  # nothing may depend on the place
        cls.headers = cls.prefix / "include"
        pkgconfig = next(cls.prefix.glob("lib/**/pkgconfig"))
        cls.libraries = pkgconfig.parent
        cls.environment = {"PATH": os.environ["PATH"], "PKG_CONFIG_PATH": str(pkgconfig),
                           "CMAKE_PREFIX_PATH": str(cls.prefix)}

    def flags(self, option):  # letters of the folder are escaped, byte by byte
        return shlex.split(run("pkg-config", option, "dpxlsx", env=self.environment))

    def columns_by(self, host, *arguments):
        return run(host, SAMPLE, *arguments,
                   env={**self.environment, "LD_LIBRARY_PATH": str(self.libraries)})

    def test_every_header_compiles_alone(self):
        exporting = {f"dpxlsx/{path.relative_to(SOURCE)}" for folder in
                     ("model", "formats", "store", "readers", "provider")
                     for path in SOURCE.glob(f"{folder}/**/*.h") if "DPXLSX_API" in path.read_text()}
        installed = {str(path.relative_to(self.headers)) for path in self.headers.glob("**/*.h")}
        self.assertEqual({path.split("/")[0] for path in installed}, {"dpxlsx"})
        self.assertEqual(exporting - installed, set(), "export something, but are not installed")

        def compiled(job):
            compiler, header = job
            older = header.startswith(("dpxlsx/model/", "dpxlsx/formats/", "dpxlsx/readers/"))
            standard = "c++17" if older else "c++20"
            return run(compiler, f"-std={standard}", *WARNINGS, "-fsyntax-only", "-x", "c++",
                       "-include", header, "-I", own, "-I", self.headers, "/dev/null", cwd=self.work)

        # A host's own files of the same names, earlier in the search.
        own = self.work / "own"
        for name in ("model/string.h", "store/conversion.h", "readers/limits.h", "i_string.h"):
            (own / name).parent.mkdir(parents=True, exist_ok=True)
            (own / name).write_text("#error the header of the host\n")

        jobs = [("g++", header) for header in sorted(installed)]
        jobs += [("clang++", header) for header in sorted(installed) if header.startswith("dpxlsx/model/host")]
        with multiprocessing.pool.ThreadPool(2) as pool:
            pool.map(compiled, jobs)

    def test_inline_functions_reach_what_the_library_exports(self):
        source = "".join(f"#include <{path.relative_to(self.headers)}>\n"
                         for path in sorted(self.headers.glob("**/*.h")))
        (self.work / "inline.cpp").write_text(source + """
int main() {
    dp::CellColumn column;
    dp::ExternalDataRecordCell cell;
    cell.initialize();
    cell.type = dp::CELL_TEXT;
    cell.textValue = "texts wait, and are delivered when they are read";
    for (unsigned row = 0; row < 3; ++row) column.assign(row, cell);
    for (const auto& entry : column)
        if (entry.second.textValue() != cell.textValue) return 1;
}
""")
        # Kept inline functions are linked although nobody calls them.
        run("g++", "-std=c++20", "-fkeep-inline-functions", "inline.cpp", "-o", "inline",
            *self.flags("--cflags"), *self.flags("--libs"), f"-Wl,-rpath,{self.libraries}",
            cwd=self.work)
        run(self.work / "inline")

    def test_examples_print_the_same_by_every_road(self):
        outputs = {}
        for compiler in COMPILERS:
            made = self.work / compiler
            made.mkdir()
            for name in ("minimal_host", "linked_host"):
                shutil.copy(SOURCE / "examples" / f"{name}.cpp", made)
                self.assertLess((made / f"{name}.cpp").read_text().count("\n"), 60)
                # The first gets no library to link with: it loads it.
                run(compiler, "-std=c++17", *WARNINGS, *self.flags("--cflags"), "-o", made / name,
                    made / f"{name}.cpp", *(self.flags("--libs") if name == "linked_host" else []))
                outputs[compiler, name, "pkg-config"] = self.columns_by(made / name)
            library = next(self.libraries.glob("libdpxlsx.so.?"))
            outputs[compiler, "dlopen"] = self.columns_by(made / "minimal_host", library)

            (made / "CMakeLists.txt").write_text(ROADS)
            run(CMAKE, "-G", "Ninja", "-S", made, "-B", made / "build", env={**self.environment, "CXX": compiler})
            run(CMAKE, "--build", made / "build", env=self.environment)
            for name in ("minimal_host", "linked_host"):
                outputs[compiler, name, "find_package"] = run(made / "build" / name, SAMPLE)
        wanted = outputs["g++", "dlopen"]
        self.assertIn("Day: type 2, 12 rows, ", wanted)
        self.assertEqual(wanted.count("\n"), 14)
        for road, output in outputs.items():
            self.assertEqual(output, wanted, road)

    def test_guide_is_true_code(self):
        guide = (SOURCE / "docs" / "host-guide.md").read_text()
        blocks = re.findall(r"^```(\w+)\n(.*?)^```", guide, re.MULTILINE | re.DOTALL)
        made = self.work / "guide"
        made.mkdir()
        cpp = [code for language, code in blocks if language == "cpp"]
        files = {match[1]: code for code in cpp if (match := re.match(r"// (\S+)\n", code))}
        self.assertEqual(set(files), {"host.cpp", "date_times.h"})
        for name, code in files.items():
            (made / name).write_text(code)
        for i, code in enumerate(code for code in cpp if code not in files.values()):
            fragment = made / f"fragment{i}.cpp"
            fragment.write_text(FRAGMENT % code)
            for compiler in COMPILERS:
                run(compiler, "-std=c++17", *WARNINGS, *self.flags("--cflags"), "-fsyntax-only", fragment)
        for compiler in COMPILERS:
            for command in (code for language, code in blocks if language == "sh"):
                command = command.strip().replace("c++ ", compiler + " ").replace(".cpp ", f".cpp {' '.join(STRICT)} ")
                # Evaluated, since pkg-config escapes the letters of this folder.
                run("sh", "-ec", f'eval "{command}"', cwd=made, env=self.environment)
            shown = self.columns_by(made / "host")
            self.assertIn("  Day, 12 rows: [Feb 26, 2024] [Feb 27, 2024] [Feb 28, 2024]\n", shown)
            self.assertIn("  Fixed, 12 rows: [-3.00] [-0.50] [2.00]\n", shown)
            self.assertIn("Readings 2024\n", shown)
        (made / "CMakeLists.txt").write_text(*[code for language, code in blocks if language == "cmake"])
        run(CMAKE, "-G", "Ninja", "-S", made, "-B", made / "build", env=self.environment)
        run(CMAKE, "--build", made / "build", env=self.environment)
        self.assertEqual(run(made / "build" / "host", SAMPLE), shown)
        run(made / "host", "/no.xlsx", expected=1, env={**self.environment, "LD_LIBRARY_PATH": str(self.libraries)})
        (made / "dates.cpp").write_text(DATES)
        run("g++", "-std=c++17", *self.flags("--cflags"), "dates.cpp", "-o", "dates", cwd=made)
        self.assertEqual(run(made / "dates"), "1900-01-01 1, 1900-02-28 59, 1900-03-01 61, 1950-06-30 18444, "
                         "2024-02-29 45351, no, no\n18:00:00 12:00:00\n")
        # Every operation of the provider that sets something is explained.
        settings = set(re.findall(r"\b((?:Set|Clear)\w+)\(", (self.headers / "dpxlsx/model/host/i_data_provider.h").read_text()))
        inner = {"SetWorksheetIndex"}  # is the readers' own
        self.assertEqual({name for name in settings - inner if f"{name}" not in guide}, set())

    def test_the_host_of_the_readme_runs(self):
        (code,) = re.findall(r"^```cpp\n(.*?)^```", (SOURCE / "README.md").read_text(), re.MULTILINE | re.DOTALL)
        includes, body = code.split("\n\n", 1)
        made = self.work / "readme"
        made.mkdir()
        (made / "host.cpp").write_text(README_HOST % (includes, body))
        shutil.copy(SAMPLE, made / "book.xlsx")
        for compiler in COMPILERS:
            run(compiler, "-std=c++17", *WARNINGS, *self.flags("--cflags"), "host.cpp", "-o", "host", cwd=made)
            self.assertEqual(run(made / "host", cwd=made, env={"LD_LIBRARY_PATH": str(self.libraries)}),
                             "1: 13 rows\n2: 10 rows\n")

    def test_the_library_alone_needs_nothing_of_the_tool(self):
        alone = self.work / "alone"
        run(CMAKE, "-S", SOURCE, "-B", alone, "-DDPXLSX_TOOL=OFF", "-DCMAKE_DISABLE_FIND_PACKAGE_CLI11=ON",
            "-DCMAKE_DISABLE_FIND_PACKAGE_nlohmann_json=ON")
        installs = (alone / "cmake_install.cmake").read_text()
        self.assertIn("libdpxlsx.so", installs)
        self.assertNotRegex(installs, r"bin/dpxlsx|dpxlsx\.1\b|tool\.md")

    def test_tool_finds_its_library_and_its_page_names_every_option(self):
        tool = self.prefix / "bin" / "dpxlsx"
        self.assertIn("Measurements", run(tool, "--list", SAMPLE, env=self.environment))
        version = run(tool, "--version").splitlines()[0].split()[-1]
        self.assertEqual(run("pkg-config", "--modversion", "dpxlsx", env=self.environment).strip(), version)
        self.assertTrue((self.libraries / f"libdpxlsx.so.{version}").is_file())
        page = next(self.prefix.glob("share/man/man1/dpxlsx.1*"))
        text = run("man", "--warnings", "-l", page, env={**self.environment, "MANROFFOPT": "-c", "MANWIDTH": "100",
                                           "LC_ALL": "C"})
        options = set(re.findall(r"--[a-z][a-z-]*", run(tool, "--help")))
        self.assertGreater(len(options), 20)
        self.assertEqual({option for option in options if option not in text}, set())


if __name__ == "__main__":
    unittest.main()
