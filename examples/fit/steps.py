"""Writes PMML 4.4 models whose derived fields are the preprocessing steps of a scikit-learn pipeline."""
from xml.sax.saxutils import escape, quoteattr

import pmml


def derived(name, optype, data_type, lines):
    return [f'<DerivedField name={quoteattr(name)} optype="{optype}" dataType="{data_type}">',
            *("  " + line for line in lines), "</DerivedField>"]


def standard_scaler(name, field, mean, scale):
    """(field - mean) / scale: two pieces of one line, which goes on beyond both ends."""
    points = [f'  <LinearNorm orig="{float(mean + side * scale)!r}" norm="{side}"/>' for side in (-1, 0, 1)]
    return derived(name, "continuous", "double",
                   [f"<NormContinuous field={quoteattr(field)}>", *points, "</NormContinuous>"])


def indicator(name, field, category):
    return derived(name, "continuous", "double",
                   [f"<NormDiscrete field={quoteattr(field)} value={quoteattr(category)}/>"])


def bins(name, field, edges, labels, optype="categorical"):
    """Bins that hold their lower edges; the first and the last have no end."""
    lines = [f"<Discretize field={quoteattr(field)}>"]
    for number, label in enumerate(labels):
        low = "" if number == 0 else f' leftMargin="{float(edges[number])!r}"'
        high = "" if number == len(labels) - 1 else f' rightMargin="{float(edges[number + 1])!r}"'
        lines += [f"  <DiscretizeBin binValue={quoteattr(label)}>",
                  f'    <Interval closure="closedOpen"{low}{high}/>', "  </DiscretizeBin>"]
    return derived(name, optype, "string", lines + ["</Discretize>"])


def table(name, field, values):
    """A number for each category."""
    rows = [f"    <row><category>{escape(category)}</category><number>{float(number)!r}</number></row>"
            for category, number in values.items()]
    return derived(name, "continuous", "double",
                   ['<MapValues outputColumn="number">',
                    f'  <FieldColumnPair field={quoteattr(field)} column="category"/>',
                    "  <InlineTable>", *rows, "  </InlineTable>", "</MapValues>"])


def function(name, text, *arguments):
    """A function of fields and numbers."""
    lines = [f'  <FieldRef field={quoteattr(argument)}/>' if isinstance(argument, str) else
             f'  <Constant dataType="double">{float(argument)!r}</Constant>' for argument in arguments]
    return derived(name, "continuous", "double", [f"<Apply function={quoteattr(text)}>", *lines, "</Apply>"])


class Pipeline:
    """A classification: data fields, derived fields and the lines of the model itself.

    fields: name to None (a number) or to a list of categories; replacements: name to what a missing value becomes;
    shared: derived fields of the document; own: those of the model. Both are lists of what the functions above give.
    """

    def __init__(self, name, fields, target, categories, replacements=(), shared=(), own=()):
        self.name, self.fields, self.target, self.categories = name, fields, target, categories
        self.replacements, self.shared, self.own = dict(replacements), shared, own

    def write_regression(self, path, category, intercept, terms):
        """terms: (field, category or None, coefficient), for the logit of one of two categories."""
        lines = [f'<RegressionTable targetCategory={quoteattr(category)} intercept="{float(intercept)!r}">']
        for field, value, coefficient in terms:
            kind, value = ("Numeric", "") if value is None else ("Categorical", f" value={quoteattr(value)}")
            lines.append(f"  <{kind}Predictor name={quoteattr(field)}{value} "
                         f'coefficient="{float(coefficient)!r}"/>')
        self.write(path, "RegressionModel", ' normalizationMethod="logit"', lines + ["</RegressionTable>"])

    def write_tree(self, path, fitted, predicates):
        """predicates: by input of the tree, a function of a threshold that gives the predicates of both sides."""
        tree = fitted.tree_

        def node_lines(node, predicate, indent):
            counts = tree.value[node, 0]
            best = self.categories[counts.argmax()]
            yield f'{indent}<Node id="{node}" score={quoteattr(best)} recordCount="{int(counts.sum())}">'
            yield f"{indent}  {predicate}"
            for category, count in zip(self.categories, counts):
                yield f'{indent}  <ScoreDistribution value={quoteattr(category)} recordCount="{int(count)}"/>'
            if tree.children_left[node] >= 0:
                sides = predicates[tree.feature[node]](float(tree.threshold[node]))
                for child, side in zip((tree.children_left[node], tree.children_right[node]), sides):
                    yield from node_lines(child, side, indent + "  ")
            yield f"{indent}</Node>"

        self.write(path, "TreeModel", ' splitCharacteristic="binarySplit"', list(node_lines(0, "<True/>", "")))

    def write(self, path, tag, attributes, lines):
        with open(path, "w", encoding="utf-8", newline="\n") as out:
            out.write("\n".join(self.lines(tag, attributes, lines)) + "\n")

    def lines(self, tag, attributes, lines):
        yield '<?xml version="1.0" encoding="UTF-8"?>'
        yield '<PMML xmlns="http://www.dmg.org/PMML-4_4" version="4.4">'
        yield f"  <Header description={quoteattr(self.name)}/>"
        yield f'  <DataDictionary numberOfFields="{len(self.fields) + 1}">'
        for field, categories in [*self.fields.items(), (self.target, self.categories)]:
            if categories is None:
                yield f'    <DataField name={quoteattr(field)} optype="continuous" dataType="double"/>'
                continue
            yield f'    <DataField name={quoteattr(field)} optype="categorical" dataType="string">'
            yield from (f"      <Value value={quoteattr(category)}/>" for category in categories)
            yield "    </DataField>"
        yield "  </DataDictionary>"
        yield from self.transformation_lines("TransformationDictionary", self.shared, "  ")
        yield f'  <{tag} modelName={quoteattr(self.name)} functionName="classification"{attributes}>'
        yield "    <MiningSchema>"
        for field in self.fields:
            replaced = self.replacements.get(field)
            treatment = "" if replaced is None else f" missingValueReplacement={quoteattr(replaced)}"
            yield f"      <MiningField name={quoteattr(field)}{treatment}/>"
        yield f'      <MiningField name={quoteattr(self.target)} usageType="target"/>'
        yield "    </MiningSchema>"
        yield from self.transformation_lines("LocalTransformations", self.own, "    ")
        yield from ("    " + line for line in lines)
        yield f"  </{tag}>"
        yield "</PMML>"

    @staticmethod
    def transformation_lines(tag, fields, indent):
        if not fields:
            return
        yield f"{indent}<{tag}>"
        for field in fields:
            yield from (f"{indent}  {line}" for line in field)
        yield f"{indent}</{tag}>"

    def write_answers(self, script, chances):
        """The training program's probabilities, a row a case and a column a category."""
        pmml.write_table(pmml.here(script, "expected.csv"),
                         ["prediction", "probability"] + ["probability_" + name for name in self.categories],
                         [[self.categories[row.argmax()], row.max()] + list(row) for row in chances])
