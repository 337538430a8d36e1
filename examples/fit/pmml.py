"""Writes a PMML 4.4 model and the tables that go with an example: data.csv and expected.csv.

Numbers are written with repr(), the shortest text that reads back to the same double.
"""
import csv
import os
from xml.sax.saxutils import quoteattr


class Document:
    """A model of one kind: the inputs, all continuous, and the target."""

    def __init__(self, name, inputs, target, categories=None):
        self.name = name
        self.inputs = inputs  # names of the continuous inputs
        self.target = target
        self.categories = categories  # None for regression

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
        yield from self.model_lines()
        yield "</PMML>"

    def function(self):
        return "regression" if self.categories is None else "classification"

    def mining_schema_lines(self):
        yield "    <MiningSchema>"
        for name in self.inputs:
            yield f'      <MiningField name={quoteattr(name)}/>'
        yield f'      <MiningField name={quoteattr(self.target)} usageType="target"/>'
        yield "    </MiningSchema>"


class Model(Document):
    """A regression model to be written: fields, target and one table per equation."""

    def __init__(self, name, inputs, target, categories=None, normalization="none"):
        super().__init__(name, inputs, target, categories)
        self.normalization = normalization
        self.tables = []  # (target category or None, intercept, coefficients)

    def add_table(self, intercept, coefficients, category=None):
        self.tables.append((category, float(intercept), [float(c) for c in coefficients]))

    def model_lines(self):
        yield (f'  <RegressionModel modelName={quoteattr(self.name)} functionName="{self.function()}" '
               f'normalizationMethod="{self.normalization}">')
        yield from self.mining_schema_lines()
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


class RegressionTree(Document):
    """A binary tree that scikit-learn fitted; its nodes are called by scikit-learn's numbers."""

    def __init__(self, name, inputs, target, fitted):
        super().__init__(name, inputs, target)
        self.tree = fitted.tree_

    def model_lines(self):
        yield (f'  <TreeModel modelName={quoteattr(self.name)} functionName="{self.function()}" '
               'splitCharacteristic="binarySplit">')
        yield from self.mining_schema_lines()
        yield from self.node_lines(0, "<True/>", "    ")
        yield "  </TreeModel>"

    def node_lines(self, node, predicate, indent):
        tree = self.tree
        yield (f'{indent}<Node id="{node}" score="{float(tree.value[node, 0, 0])!r}" '
               f'recordCount="{tree.n_node_samples[node]}">')
        yield f"{indent}  {predicate}"
        left, right = tree.children_left[node], tree.children_right[node]
        if left >= 0:
            yield from self.node_lines(left, self.predicate(node, "lessOrEqual"), indent + "  ")
            yield from self.node_lines(right, self.predicate(node, "greaterThan"), indent + "  ")
        yield f"{indent}</Node>"

    def predicate(self, node, operator):
        name, threshold = self.inputs[self.tree.feature[node]], float(self.tree.threshold[node])
        return f'<SimplePredicate field={quoteattr(name)} operator="{operator}" value="{threshold!r}"/>'


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
