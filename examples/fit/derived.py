"""Writes the tables of an example of derived fields: data.csv and derived.csv, whose columns are the derived fields."""
import csv
import os


def rows_of(example, columns, step=1):
    """Every so-many-th row of another example's data, as texts by column."""
    path = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", example, "data.csv")
    with open(path, encoding="utf-8", newline="") as data:
        return [{name: row[name] for name in columns} for row in list(csv.DictReader(data))[::step]]


def number(cell):
    """None for an empty cell."""
    return float(cell) if cell else None


def cell(value):
    """None is an empty cell, true is 1."""
    if value is None or isinstance(value, str):
        return value or ""
    return repr(float(value))


def write(script, rows, derive):
    """`derive` gives the derived fields of a row, by name and in order."""
    folder = os.path.dirname(os.path.abspath(script))
    for name, table in (("data.csv", rows), ("derived.csv", [derive(row) for row in rows])):
        with open(os.path.join(folder, name), "w", encoding="utf-8", newline="") as out:
            writer = csv.writer(out, lineterminator="\n")
            writer.writerow(table[0])
            writer.writerows([cell(value) for value in row.values()] for row in table)
