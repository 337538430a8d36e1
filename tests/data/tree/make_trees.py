#!/usr/bin/env python3
"""Makes the random trees in random/: sixty documents, NN.xml, each with forty cases and their answers, NN.csv.

    ./make_trees.py        writes all of them again, always the same

A table has a header line, commas and no quotes. Its columns:

    an input by its name    x1... numbers, c1... nominal and o1... ordinal texts; empty is missing. A text that its
                            field does not list is missing, too (invalidValueTreatment="asMissing")
    prediction              empty: there is none, and nothing behind it
    probability             how sure the prediction is. This and the next only in a classification
    probability_CATEGORY    one for each of the target's, in its order. Empty beside a prediction: not defined, because
                            confidences that are no probabilities were joined
    node                    the node that decided, "#k" for the k-th of the document where it has no id; empty where
                            several were joined; "?" where several were asked and only one answered: compare nothing

Numbers are written with repr(). Inputs lie on a threshold exactly or far from all of them, and a joined prediction is
never a matter of the last digit, so no answer depends on rounding.

What the documents leave out, since readers refuse it: sets and comparisons with unlisted values, order in nominal
fields, intervals that hold nothing, compounds that hold nothing.
"""
import csv
import os
import random
from xml.sax.saxutils import escape, quoteattr

from score_tree import Tree

DOCUMENTS = 60
CASES = 40
CANDIDATES = 1500  # of which the most varied cases are kept
MOST_NODES = 36
STRATEGIES = ["none", "lastPrediction", "nullPrediction", "defaultChild", "weightedConfidence", "aggregateNodes"]
JOINING = STRATEGIES[4:]
COLOURS = ["red", "green", "light blue", "salt & pepper", "7", "black", "Red", "violet"]
SIZES = ["XS", "S", "M", "L", "XL", "2 XL"]
LABELS = ["yes", "no", "can't say", "<none>"]
OPPOSITES = {"lessThan": "greaterOrEqual", "lessOrEqual": "greaterThan", "equal": "notEqual"}


class NumberField:
    """Values lie on its thresholds, half way between two, or beyond them all. A room: the thresholds that are left."""

    def __init__(self, rng, name):
        self.name = name
        self.is_integer = rng.random() < 0.25
        scale = 1 if self.is_integer else rng.choice([1.0, 1.0, 1e-5, 1e6])
        steps = [rng.randint(2, 5) for _ in range(7)]
        start = rng.randint(-12, 3)
        grid = [start + sum(steps[:i]) for i in range(8)]
        if not self.is_integer:
            digits = rng.choice([1, 17])
            grid = [round(place / 3, digits) * scale for place in grid]
        self.thresholds = grid[1:-1]
        halves = [(low + high) / 2 for low, high in zip(grid, grid[1:])]
        self.values = self.thresholds + halves + [grid[0] - scale, grid[-1] + scale, 1000.0 * scale]

    def element(self):
        kind = "integer" if self.is_integer else "double"
        return [f'    <DataField name="{self.name}" optype="continuous" dataType="{kind}"/>']

    def cell(self, rng):
        return repr(rng.choice(self.values))

    def random_test(self, rng):
        return self.test(rng.choice(list(OPPOSITES) + list(OPPOSITES.values())), rng.choice(self.thresholds))

    def test(self, operator, value):
        return [f'<SimplePredicate field="{self.name}" operator="{operator}" value="{value!r}"/>']

    def whole_room(self):
        return self.thresholds

    @staticmethod
    def can_split(room):
        return len(room) >= 1

    def partition(self, rng, room):
        """Predicates of which one is true for each value, and the rooms that they leave."""
        if len(room) < 3 or rng.random() < 0.6:
            place = rng.randrange(len(room))
            operator = rng.choice(list(OPPOSITES))
            tests = [self.test(operator, room[place]), self.test(OPPOSITES[operator], room[place])]
            rooms = [[], room[:place] + room[place + 1:]] if operator == "equal" else [room[:place], room[place + 1:]]
            return shuffled_together(rng, tests, rooms)
        low, high = sorted(rng.sample(range(len(room)), 2))
        between = compound("and", [self.test("greaterThan", room[low]), self.test("lessOrEqual", room[high])])
        tests = [self.test("lessOrEqual", room[low]), between, self.test("greaterThan", room[high])]
        return tests, [room[:low], room[low + 1:high], room[high + 1:]]


class TextField:
    """A nominal or ordinal field, or a target. A room: the categories that are left."""

    def __init__(self, rng, name, categories, is_ordinal):
        self.name = name
        self.is_ordinal = is_ordinal
        self.categories = categories
        self.values = categories + ([] if rng is None else ["of no category"])

    def element(self):
        optype = "ordinal" if self.is_ordinal else "categorical"
        opening = f'    <DataField name="{self.name}" optype="{optype}" dataType="string">'
        values = [f"      <Value value={quoteattr(category)}/>" for category in self.categories]
        return [opening] + values + ["    </DataField>"]

    def cell(self, rng):
        return rng.choice(self.values) if rng.random() < 0.1 else rng.choice(self.categories)

    def random_test(self, rng):
        if rng.random() < 0.4:
            members = rng.sample(self.categories, rng.randint(1, len(self.categories) - 1))
            return self.set_test(rng, rng.choice(["isIn", "isNotIn"]), members)
        operator = rng.choice(["equal", "notEqual"] + self.orderings())
        first = 1 if operator == "lessThan" else 0
        end = len(self.categories) - (1 if operator == "greaterThan" else 0)
        return self.test(operator, rng.choice(self.categories[first:end]))

    def orderings(self):
        return ["lessThan", "lessOrEqual", "greaterThan", "greaterOrEqual"] if self.is_ordinal else []

    def test(self, operator, value):
        return [f'<SimplePredicate field="{self.name}" operator="{operator}" value={quoteattr(value)}/>']

    def set_test(self, rng, operator, members):
        plain = all(" " not in member for member in members) and rng.random() < 0.5
        text = " ".join(member if plain else f'"{member}"' for member in members)
        return [f'<SimpleSetPredicate field="{self.name}" booleanOperator="{operator}">',
                f'  <Array n="{len(members)}" type="string">{escape(text)}</Array>', "</SimpleSetPredicate>"]

    def whole_room(self):
        return self.categories

    @staticmethod
    def can_split(room):
        return len(room) >= 2

    def partition(self, rng, room):
        if self.is_ordinal and rng.random() < 0.6:
            place = rng.randrange(1, len(room))
            if rng.random() < 0.5:
                tests = [self.test("lessThan", room[place]), self.test("greaterOrEqual", room[place])]
            else:
                tests = [self.test("lessOrEqual", room[place - 1]), self.test("greaterThan", room[place - 1])]
            return shuffled_together(rng, tests, [room[:place], room[place:]])
        if rng.random() < 0.3:
            one, others = room[0], room[1:]
            return [self.test("equal", one), self.test("notEqual", one)], [[one], others]
        mixed = rng.sample(room, len(room))
        cuts = sorted(rng.sample(range(1, len(room)), min(len(room) - 1, rng.choice([1, 1, 2, 3]))))
        parts = [mixed[first:end] for first, end in zip([0] + cuts, cuts + [len(room)])]
        tests = [self.test("equal", part[0]) if len(part) == 1 else self.set_test(rng, "isIn", part) for part in parts]
        if rng.random() < 0.4:
            outside = [category for category in self.categories if category not in parts[-1]]
            tests[-1] = self.set_test(rng, "isNotIn", outside)
        return tests, parts


def shuffled_together(rng, first, second):
    order = rng.sample(range(len(first)), len(first))
    return [first[i] for i in order], [second[i] for i in order]


def indented(lines):
    return ["  " + line for line in lines]


def compound(operator, parts):
    lines = [line for part in parts for line in part]
    return [f'<CompoundPredicate booleanOperator="{operator}">'] + indented(lines) + ["</CompoundPredicate>"]


class Document:
    """One random tree and how it treats missing values."""

    def __init__(self, seed):
        self.rng = rng = random.Random(f"tree {seed}")
        self.strategy = STRATEGIES[seed % 6]
        self.last_without_true_child = seed // 6 % 2 == 1
        self.is_regression = seed // 12 % 2 == 1
        self.depth = 1 + (seed + seed // 6) % 6
        self.surrogates = rng.random() < 0.5
        self.penalty = rng.choice([1, 1, 0.8, 0.95])
        if self.strategy in JOINING and self.surrogates:
            self.penalty = 1  # what a surrogate inside a joined prediction costs is not defined
        self.fields = [NumberField(rng, f"x{i + 1}") for i in range(rng.randint(1, 4))]
        self.fields += [TextField(rng, f"c{i + 1}", rng.sample(COLOURS, rng.randint(2, 6)), False)
                        for i in range(rng.randint(1, 2))]
        self.fields += [TextField(rng, f"o{i + 1}", SIZES[:rng.randint(3, 6)], True) for i in range(rng.randint(0, 1))]
        self.target = TextField(None, "answer", LABELS[:rng.randint(2, 4)], False)
        self.all_have_ids = self.strategy == "defaultChild" or rng.random() < 0.7
        self.all_binary = True
        self.nodes = 0

    # Predicates.

    def atom(self):
        rng = self.rng
        field = rng.choice(self.fields)
        if rng.random() < 0.15:
            operator = rng.choice(["isMissing", "isNotMissing"])
            return [f'<SimplePredicate field="{field.name}" operator="{operator}"/>']
        return ["<True/>"] if rng.random() < 0.02 else ["<False/>"] if rng.random() < 0.02 else field.random_test(rng)

    def real_atom(self):
        return self.rng.choice(self.fields).random_test(self.rng)

    def mixed_with(self, test, depth):
        """A compound around a test, which has more or less of a say in it."""
        rng = self.rng
        operator = rng.choice(["or", "and", "xor"] + (["surrogate", "surrogate"] if self.surrogates else []))
        parts = [test]
        for _ in range(rng.choice([1, 1, 1, 2, 3])):
            part = self.atom()
            parts.append(self.mixed_with(self.real_atom(), depth - 1) if depth > 1 and rng.random() < 0.4 else part)
        if operator != "surrogate":
            rng.shuffle(parts)
        if operator in ("and", "or") and rng.random() < 0.15:
            parts.insert(rng.randrange(len(parts) + 1), ["<True/>"] if operator == "and" else ["<False/>"])
        return compound(operator, parts)

    def with_surrogates(self, test):
        """A test that others stand in for, often inside a compound, to which a true surrogate is less than true."""
        rng = self.rng
        parts = [self.real_atom() for _ in range(rng.choice([1, 1, 2, 3]))]
        listed = compound("surrogate", [test] + parts)
        chance = rng.random()
        if chance < 0.5:
            return listed
        operator = rng.choice(["or", "and", "xor"])
        if chance < 0.7:  # a compound of one, with a constant that is dropped or none
            neutral = {"or": ["<False/>"], "and": ["<True/>"], "xor": []}[operator]
            return compound(operator, rng.sample([neutral, listed], 2))
        return compound(operator, rng.sample([self.real_atom(), listed], 2))

    def split(self, rooms):
        """The predicates of a node's children, and the rooms of each."""
        rng = self.rng
        splittable = [field for field in self.fields if field.can_split(rooms[field.name])]
        field = rng.choice(splittable or self.fields)
        tests, parts = field.partition(rng, rooms[field.name] if splittable else field.whole_room())
        below = [dict(rooms, **{field.name: part}) for part in parts]
        for i, test in enumerate(tests):
            chance = rng.random()
            if self.surrogates and chance < 0.4:
                tests[i] = self.with_surrogates(test)
            elif chance < 0.6 and rng.random() < 0.5:
                tests[i] = self.mixed_with(test, 2)
            elif chance < 0.65:
                tests[i], below[i] = self.atom(), rooms
        chance = rng.random()
        if chance < 0.15:
            tests[-1] = ["<True/>"]
        elif chance < 0.3:
            place = rng.choice([0, len(tests)])
            tests.insert(place, [f'<SimplePredicate field="{field.name}" operator="isMissing"/>'])
            below.insert(place, rooms)
        elif chance < 0.42:
            place = rng.randrange(len(tests))
            del tests[place], below[place]
        return tests, below

    # Nodes.

    def grown(self, predicate, rooms, depth):
        """The lines of a node and its id. The first child goes down all the way, others as there is room for."""
        rng = self.rng
        self.nodes += 1
        name = f"n{self.nodes}" if self.all_have_ids or rng.random() < 0.7 else None
        inner, children, names = depth > 0, [], []
        if inner:
            tests, below = self.split(rooms)
            deepest = rng.randrange(len(tests))
            for i, (test, room) in enumerate(zip(tests, below)):
                goes_on = i == deepest or (self.nodes < MOST_NODES and rng.random() < 0.55)
                lines, child = self.grown(test, room, depth - 1 if goes_on else 0)
                children += lines
                names.append(child)
            self.all_binary = self.all_binary and len(tests) == 2
        attributes, distribution = self.said(inner)
        if inner and self.strategy == "defaultChild":
            attributes += f' defaultChild="{rng.choice(names)}"'
        opening = "<Node" + (f' id="{name}"' if name else "") + attributes + ">"
        return [opening] + indented(predicate + distribution + children) + ["</Node>"], name

    def said(self, inner):
        """What a node predicts: attributes and the lines of its distribution."""
        rng = self.rng
        joins = self.strategy in JOINING
        silent = inner and not joins and rng.random() < 0.2
        counted = joins or rng.random() < 0.6
        if self.is_regression:
            count = rng.choice([rng.randint(1, 90), rng.randint(2, 60) / 4])
            score = "" if silent else f' score="{rng.choice([rng.randint(-9, 9), rng.uniform(-40, 40), 1e-3])!r}"'
            return score + (f' recordCount="{count!r}"' if counted else ""), []
        most = len(self.target.categories)
        categories = rng.sample(self.target.categories, rng.choice([rng.randint(1, most), most]))
        counts = [rng.choice([0, rng.randint(1, 9), rng.randint(1, 40), 5]) for _ in categories]
        counts[rng.randrange(len(counts))] += 3
        if rng.random() < 0.15:
            counts = [rng.randint(1, 20)] * len(counts)  # a tie
        total = f' recordCount="{sum(counts)}"' if counted else ""
        if silent:
            return total, []
        if self.strategy != "aggregateNodes" and rng.random() < 0.15:
            return f" score={quoteattr(rng.choice(categories))}{total}", []
        score = f" score={quoteattr(rng.choice(categories))}" if rng.random() < 0.6 else ""
        return score + total, self.distribution(categories, counts)

    def distribution(self, categories, counts):
        rng = self.rng
        confidences, probabilities = rng.random() < 0.3, rng.random() < 0.3
        cuts = sorted(rng.randint(0, 64) for _ in categories[1:])
        shares = [(end - first) / 64 for first, end in zip([0] + cuts, cuts + [64])]
        lines = []
        for category, count, share in zip(categories, counts, shares):
            line = f'<ScoreDistribution value={quoteattr(category)} recordCount="{count}"'
            if confidences and rng.random() < 0.8:
                line += f' confidence="{round(rng.random(), 3)!r}"'
            lines.append(line + (f' probability="{share!r}"/>' if probabilities else "/>"))
        return lines

    def root_predicate(self):
        rng = self.rng
        if rng.random() < 0.75:
            return ["<True/>"]
        operator = rng.choice(["or", "or", "xor", "and"])
        return compound(operator, [self.real_atom(), self.real_atom()]) if rng.random() < 0.5 else self.real_atom()

    # The document.

    def lines(self):
        rooms = {field.name: field.whole_room() for field in self.fields}
        tree, _ = self.grown(self.root_predicate(), rooms, self.depth)
        model = '  <TreeModel functionName="' + ("regression" if self.is_regression else "classification") + '"'
        if self.strategy != "none" or self.rng.random() < 0.5:
            model += f' missingValueStrategy="{self.strategy}"'
        if self.penalty != 1:
            model += f' missingValuePenalty="{self.penalty}"'
        if self.last_without_true_child:
            model += ' noTrueChildStrategy="returnLastPrediction"'
        elif self.rng.random() < 0.5:
            model += ' noTrueChildStrategy="returnNullPrediction"'
        model += ' splitCharacteristic="' + ("binarySplit" if self.all_binary else "multiSplit") + '">'
        target = ['    <DataField name="answer" optype="continuous" dataType="double"/>']
        fields = [line for field in self.fields for line in field.element()]
        fields += target if self.is_regression else self.target.element()
        mining = [f'      <MiningField name="{field.name}"' +
                  ("/>" if isinstance(field, NumberField) else ' invalidValueTreatment="asMissing"/>')
                  for field in self.fields]
        return ['<?xml version="1.0" encoding="UTF-8"?>', '<PMML xmlns="http://www.dmg.org/PMML-4_4" version="4.4">',
                '  <Header description="a random tree"/>',
                f'  <DataDictionary numberOfFields="{len(self.fields) + 1}">', *fields, "  </DataDictionary>",
                model, "    <MiningSchema>", *mining, '      <MiningField name="answer" usageType="target"/>',
                "    </MiningSchema>", *indented(indented(tree)), "  </TreeModel>", "</PMML>"]

    def candidate(self, missing):
        return {field.name: "" if self.rng.random() < missing else field.cell(self.rng) for field in self.fields}


def is_close_call(outcome):
    """Whether rounding may choose between the two best categories of a joined prediction."""
    best = sorted(outcome.confidences.values())[-2:]
    return outcome.node in ("", "?") and len(best) == 2 and best[1] - best[0] < 1e-9


def varied_cases(document, tree):
    """Cases that take as many different ways through the tree as can be found, the rarer ways first."""
    ways = {}
    for i in range(CANDIDATES):
        cells = document.candidate((0.05, 0.2, 0.4)[i % 3])
        path = []
        outcome = tree.score({name: field.value_of(cells[name]) for name, field in tree.fields.items()}, path)
        if outcome is not None and tree.strategy == "weightedConfidence" and is_close_call(outcome):
            continue
        row = tuple(cells.values()) + tuple(tree.answer_cells(outcome))
        ways.setdefault((tuple(path), outcome is None), {})[row] = True
    kept = []
    queues = sorted((list(rows) for rows in ways.values()), key=len)
    while len(kept) < CASES and any(queues):
        kept += [queue.pop(0) for queue in queues if queue][:CASES - len(kept)]
    return kept


def make(number, folder):
    document = Document(number)
    path = os.path.join(folder, f"{number:02}.xml")
    with open(path, "w", encoding="utf-8", newline="\n") as out:
        out.write("\n".join(document.lines()) + "\n")
    tree = Tree(path)
    with open(os.path.join(folder, f"{number:02}.csv"), "w", encoding="utf-8", newline="") as out:
        table = csv.writer(out, lineterminator="\n", quoting=csv.QUOTE_NONE)
        table.writerow([field.name for field in document.fields] + tree.answer_header())
        table.writerows(varied_cases(document, tree))


if __name__ == "__main__":
    FOLDER = os.path.join(os.path.dirname(os.path.abspath(__file__)), "random")
    os.makedirs(FOLDER, exist_ok=True)
    for NUMBER in range(DOCUMENTS):
        make(NUMBER, FOLDER)
