#!/usr/bin/env python3
"""What the program costs beside reading and writing the same table: 1,000,000 rows of 20 numeric columns.

The model is a linear one; the derived field is its prediction, as a function tree.

usage: bench/program/run.py [--smoke] PROGRAM

Both sides run in turns; figures are medians of five rounds of user and system time, and the largest memory seen.
"""
import os
import random
import subprocess
import sys
import tempfile

INPUTS = 20


def write_model(path):
    """The linear model x0 * 0.5 + x1 * 0.625 + ... + 0.25."""
    fields = "".join(f'<DataField name="x{i}" optype="continuous" dataType="double"/>' for i in range(INPUTS))
    schema = "".join(f'<MiningField name="x{i}"/>' for i in range(INPUTS))
    terms = "".join(f'<NumericPredictor name="x{i}" coefficient="{0.5 + i / 8}"/>' for i in range(INPUTS))
    with open(path, "w", encoding="utf-8") as out:
        out.write(f'<PMML version="4.4"><Header/><DataDictionary numberOfFields="{INPUTS + 1}">{fields}'
                  '<DataField name="y" optype="continuous" dataType="double"/></DataDictionary>'
                  f'<RegressionModel functionName="regression"><MiningSchema>{schema}'
                  '<MiningField name="y" usageType="target"/></MiningSchema>'
                  f'<RegressionTable intercept="0.25">{terms}</RegressionTable></RegressionModel></PMML>')


def write_derived(path):
    """The same sum as a derived field."""
    fields = "".join(f'<DataField name="x{i}" optype="continuous" dataType="double"/>' for i in range(INPUTS))
    terms = "".join(f'<Apply function="*"><FieldRef field="x{i}"/><Constant>{0.5 + i / 8}</Constant></Apply>'
                    for i in range(INPUTS))
    with open(path, "w", encoding="utf-8") as out:
        out.write(f'<PMML version="4.4"><Header/><DataDictionary numberOfFields="{INPUTS}">{fields}</DataDictionary>'
                  '<TransformationDictionary><DerivedField name="y" optype="continuous" dataType="double">'
                  f'<Apply function="sum">{terms}<Constant>0.25</Constant></Apply></DerivedField>'
                  '</TransformationDictionary></PMML>')


def write_table(path, rows):
    """Seeded numbers of the kind that tables hold; a block of rows is repeated, which no reader can profit from."""
    numbers = random.Random(8)
    block = "".join(",".join(repr(round(numbers.uniform(-1000, 1000), 3)) for _ in range(INPUTS)) + "\n"
                    for _ in range(min(rows, 10_000)))
    with open(path, "w", encoding="utf-8") as out:
        out.write(",".join(f"x{i}" for i in range(INPUTS)) + "\n")
        for _ in range(max(1, rows // 10_000)):
            out.write(block)


def run(command):
    """Processor seconds and the largest memory in MB of one run."""
    process = subprocess.Popen(command)
    _, status, usage = os.wait4(process.pid, 0)
    if os.waitstatus_to_exitcode(status) != 0:
        sys.exit(f"{command} failed with {os.waitstatus_to_exitcode(status)}")
    return usage.ru_utime + usage.ru_stime, usage.ru_maxrss / 1024


def check(scored, table):
    """The first answer must be right, or the time is worth nothing."""
    with open(table, encoding="utf-8") as rows, open(scored, encoding="utf-8") as answers:
        next(rows), next(answers)
        values = [float(cell) for cell in next(rows).split(",")]
        expected = 0.25 + sum(value * (0.5 + i / 8) for i, value in enumerate(values))
        answer = float(next(answers).split(",")[0])
    if abs(answer - expected) > 1e-9 * abs(expected):
        sys.exit(f"wrong answer: {answer} instead of {expected}")


def main():
    smoke = "--smoke" in sys.argv
    program = sys.argv[-1]
    rows = 10_000 if smoke else 1_000_000
    with tempfile.TemporaryDirectory() as folder:
        model, derived, table, out = (os.path.join(folder, name)
                                      for name in ("model.xml", "derived.xml", "table.csv", "out.csv"))
        write_model(model)
        write_derived(derived)
        write_table(table, rows)
        megabytes = os.path.getsize(table) / 1e6
        sides = {
            "read and write the table, no model": [program, "copy-table", table, "-o", out],
            "score": [program, "score", model, table, "-o", out],
            "score, table copied beside the predictions": [program, "score", model, table, "--keep", "-o", out],
            "derive": [program, "derive", derived, table, "-o", out],
        }
        figures = {name: [] for name in sides}
        for _ in range(1 if smoke else 5):
            for name, command in sides.items():
                figures[name].append(run(command))
                if name in ("score", "derive"):
                    check(out, table)
        print(f"{rows} rows of {INPUTS} columns, {megabytes:.0f} MB")
        baseline = None
        for name, seen in figures.items():
            seconds = sorted(time for time, _ in seen)[len(seen) // 2]
            baseline = baseline or seconds
            print(f"  {name:45} {seconds:8.3f} s {seconds / baseline:6.2f} x {megabytes / seconds:7.0f} MB/s "
                  f"{max(memory for _, memory in seen):6.0f} MB memory")


if __name__ == "__main__":
    main()
