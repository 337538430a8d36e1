"""Writes a PMML 4.4 RegressionModel and the tables that go with an example: data.csv and expected.csv.

Numbers are written with repr(), the shortest text that reads back to the same double.
"""
import csv
import os
from xml.sax.saxutils import quoteattr


class Model:
    """A regression model to be written: fields, target and one table per equation."""

    def __init__(self, name, inputs, target, categories=None, normalization="none"):
        self.name = name
        self.inputs = inputs  # names of the continuous inputs
        self.target = target
        self.categories = categories  # None for regression
        self.normalization = normalization
        self.tables = []  # (target category or None, intercept, coefficients)

    def add_table(self, intercept, coefficients, category=None):
        self.tables.append((category, float(intercept), [float(c) for c in coefficients]))

    def write(self, path):
        with open(path, "w", encoding="utf-8", newline="\n") as out:
            out.write("\n".join(self.lines()) + "\n")

    def lines(self):
        yield '<?xml version="1.0" encoding="UTF-8"?>'
        yield '<PMML xmlns="http://www.dmg.org/PMML-4_4" version="4.4">'
        yield f'  <Header description={quoteattr(self.name)}/>'
        yield f'  <DataDictionary numberOfFields="{len(self.inputs) + 1}">'
        for name in self.inputs:
            yield f'    <DataField name={quoteattr(name)} optype="continuous" dataType="double"/>'
        if self.categories is None:
            yield f'    <DataField name={quoteattr(self.target)} optype="continuous" dataType="double"/>'
        else:
            yield f'    <DataField name={quoteattr(self.target)} optype="categorical" dataType="string">'
            for category in self.categories:
                yield f'      <Value value={quoteattr(category)}/>'
            yield "    </DataField>"
        yield "  </DataDictionary>"
        function = "regression" if self.categories is None else "classification"
        yield (f'  <RegressionModel modelName={quoteattr(self.name)} functionName="{function}" '
               f'normalizationMethod="{self.normalization}">')
        yield "    <MiningSchema>"
        for name in self.inputs:
            yield f'      <MiningField name={quoteattr(name)}/>'
        yield f'      <MiningField name={quoteattr(self.target)} usageType="target"/>'
        yield "    </MiningSchema>"
        for category, intercept, coefficients in self.tables:
            target = "" if category is None else f" targetCategory={quoteattr(category)}"
            if not coefficients:
                yield f'    <RegressionTable intercept="{intercept!r}"{target}/>'
                continue
            yield f'    <RegressionTable intercept="{intercept!r}"{target}>'
            for name, coefficient in zip(self.inputs, coefficients):
                yield f'      <NumericPredictor name={quoteattr(name)} coefficient="{coefficient!r}"/>'
            yield "    </RegressionTable>"
        yield "  </RegressionModel>"
        yield "</PMML>"


def write_table(path, header, rows):
    """Writes rows of texts and doubles as comma separated values."""
    with open(path, "w", encoding="utf-8", newline="") as out:
        writer = csv.writer(out, lineterminator="\n")
        writer.writerow(header)
        for row in rows:
            writer.writerow([cell if isinstance(cell, str) else repr(float(cell)) for cell in row])


def here(script, name):
    """The path of a file beside the script."""
    return os.path.join(os.path.dirname(os.path.abspath(script)), name)
