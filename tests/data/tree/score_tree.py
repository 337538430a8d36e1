#!/usr/bin/env python3
"""Scores cases with a PMML TreeModel, slowly and plainly: one function a rule, written from the standard's text.

The tests hold Kestrel against answers that this makes, so it shares nothing with Kestrel. It reads what the random
trees beside it and the tree examples need: active fields without replacements, and no derived fields.

    ./score_tree.py model.xml cases.csv      prints the answers in the columns that make_trees.py tells of

What the standard leaves open is settled like this:

- A child that is not decided fires the missing value strategy at once, whatever comes behind it.
- weightedConfidence scores each child that is not false as a tree of its own. What its categories have for confidence
  is weighted by the child's share of the records of the children that predict. The winner is the category with the
  highest sum; of equal ones the first of the target's.
- aggregateNodes collects leaves: below an undecided node all children that are not false are followed, below a decided
  one the true child alone. The record counts of the leaves' distributions are added up.
- The penalty is taken once for each step to a default child, and for each that a surrogate decided.
- A surrogate that is true is neither true to "or" and "xor" nor false to "and".
- A compound of one predicate is that predicate; "and" drops True, "or" drops False.
"""
import csv
import re
import sys
import xml.etree.ElementTree as ElementTree

TRUE, FALSE, UNKNOWN, SURROGATE = "true", "false", "unknown", "true by a surrogate"

ORDERINGS = {
    "lessThan": lambda x, bound: x < bound,
    "lessOrEqual": lambda x, bound: x <= bound,
    "greaterThan": lambda x, bound: x > bound,
    "greaterOrEqual": lambda x, bound: x >= bound,
}


def decided(condition):
    return TRUE if condition else FALSE


def tag_of(element):
    return element.tag.rpartition("}")[2]


def children_of(element, *tags):
    return [child for child in element if tag_of(child) in tags]


def number_of(element, attribute):
    text = element.get(attribute)
    return None if text is None else float(text)


class Field:
    """A data field: its kind, its categories in their order, and what an unlisted category is."""

    def __init__(self, element):
        self.name = element.get("name")
        self.is_number = element.get("optype") == "continuous"
        self.is_ordinal = element.get("optype") == "ordinal"
        self.categories = [value.get("value") for value in children_of(element, "Value")]
        self.unlisted_is_missing = False

    def value_of(self, cell):
        """None is missing."""
        if cell == "":
            return None
        if self.is_number:
            return float(cell)
        if cell in self.categories:
            return cell
        if self.unlisted_is_missing:
            return None
        raise ValueError(f"{self.name} has no category {cell}")


class Predicates:
    """Turns predicate elements into functions from a case, a dict of values, to one of the four answers."""

    NAMES = ("SimplePredicate", "SimpleSetPredicate", "CompoundPredicate", "True", "False")

    def __init__(self, fields):
        self.fields = fields

    def read(self, element):
        tag = tag_of(element)
        if tag == "True":
            return lambda case: TRUE
        if tag == "False":
            return lambda case: FALSE
        if tag == "CompoundPredicate":
            return self.read_compound(element)
        field = self.fields[element.get("field")]
        test = self.read_simple(element, field) if tag == "SimplePredicate" else self.read_set(element)
        if element.get("operator") == "isMissing":
            return lambda case: decided(case[field.name] is None)
        return lambda case: UNKNOWN if case[field.name] is None else decided(test(case[field.name]))

    @staticmethod
    def read_simple(element, field):
        operator, text = element.get("operator"), element.get("value")
        if operator in ("isMissing", "isNotMissing"):
            return lambda value: True
        wanted = float(text) if field.is_number else text
        if operator == "equal":
            return lambda value: value == wanted
        if operator == "notEqual":
            return lambda value: value != wanted
        if field.is_number:
            return lambda value: ORDERINGS[operator](value, wanted)
        if not field.is_ordinal:
            raise ValueError(f"{field.name} has no order")
        place = field.categories.index
        return lambda value: ORDERINGS[operator](place(value), place(wanted))

    @staticmethod
    def read_set(element):
        text = children_of(element, "Array")[0].text
        members = {quoted or plain for quoted, plain in re.findall(r'"([^"]*)"|(\S+)', text)}
        if element.get("booleanOperator") == "isIn":
            return lambda value: value in members
        return lambda value: value not in members

    def read_compound(self, element):
        operator = element.get("booleanOperator")
        neutral = {"and": "True", "or": "False"}.get(operator)
        parts = [self.read(part) for part in children_of(element, *self.NAMES) if tag_of(part) != neutral]
        if len(parts) == 1:
            return parts[0]
        return lambda case: getattr(self, "join_" + operator)([part(case) for part in parts])

    # All parts are asked, which changes nothing: none has an effect but its answer.

    @staticmethod
    def join_or(answers):
        if TRUE in answers:
            return TRUE
        return UNKNOWN if UNKNOWN in answers else FALSE

    @staticmethod
    def join_and(answers):
        if FALSE in answers:
            return FALSE
        return UNKNOWN if UNKNOWN in answers else TRUE

    @staticmethod
    def join_xor(answers):
        if UNKNOWN in answers:
            return UNKNOWN
        return decided(answers.count(TRUE) % 2 == 1)

    @staticmethod
    def join_surrogate(answers):
        if answers[0] != UNKNOWN:
            return answers[0]
        for answer in answers:
            if answer != UNKNOWN:
                return SURROGATE if answer == TRUE else answer
        return UNKNOWN


class Node:
    """One Node element with those below it."""

    def __init__(self, element, predicates, counter):
        counter.append(None)
        self.name = element.get("id", f"#{len(counter)}")
        self.predicate = predicates.read(children_of(element, *Predicates.NAMES)[0])
        self.score = element.get("score")
        self.record_count = number_of(element, "recordCount")
        self.default_child = element.get("defaultChild")
        self.entries = children_of(element, "ScoreDistribution")
        self.children = [Node(child, predicates, counter) for child in children_of(element, "Node")]

    def counts(self):
        """Records by category, in the order of the distribution."""
        return {entry.get("value"): number_of(entry, "recordCount") for entry in self.entries}

    def probabilities(self):
        if not self.entries:
            return {self.score: 1.0}
        given = {entry.get("value"): number_of(entry, "probability") for entry in self.entries}
        if None not in given.values():
            return given
        counts = self.counts()
        total = sum(counts.values())
        return {category: count / total for category, count in counts.items()}

    def confidences(self):
        confidences = self.probabilities()
        for entry in self.entries:
            if entry.get("confidence") is not None:
                confidences[entry.get("value")] = number_of(entry, "confidence")
        return confidences

    def has_own_confidences(self):
        return any(entry.get("confidence") is not None for entry in self.entries)


class Outcome:
    """A prediction and all that was found out with it."""

    def __init__(self, prediction, node):
        self.prediction = prediction
        self.node = node  # which one decided; "" for several, "?" where several were asked and one answered
        self.confidence = None
        self.probabilities = {}  # None: not defined, since confidences of several nodes were joined
        self.confidences = {}
        self.contributors = 1


def first_highest(shares, order):
    """The category with the highest share, the first in the given order of those that have it."""
    return max((category for category in order if category in shares), key=lambda category: shares[category])


class Tree:
    """A TreeModel. Scoring gives an Outcome, or None where there is no prediction."""

    def __init__(self, path):
        root = ElementTree.parse(path).getroot()
        dictionary = {field.get("name"): Field(field) for field in root.iter() if tag_of(field) == "DataField"}
        model = children_of(root, "TreeModel")[0]
        self.fields = {}
        for mining in children_of(children_of(model, "MiningSchema")[0], "MiningField"):
            field = dictionary[mining.get("name")]
            field.unlisted_is_missing = mining.get("invalidValueTreatment") == "asMissing"
            if mining.get("usageType", "active") == "active":
                self.fields[field.name] = field
            else:
                self.target = field
        self.is_regression = model.get("functionName") == "regression"
        self.strategy = model.get("missingValueStrategy", "none")
        self.penalty = float(model.get("missingValuePenalty", "1"))
        self.last_without_true_child = model.get("noTrueChildStrategy") == "returnLastPrediction"
        self.root = Node(children_of(model, "Node")[0], Predicates(self.fields), [])

    def score(self, case, path=None):
        """case: a dict of values. path: a list that gets the steps, each as the node's name and how it was reached."""
        path = [] if path is None else path
        if self.root.predicate(case) != TRUE:
            return None
        return self.descend(self.root, case, path, 0)

    def descend(self, node, case, path, penalties):
        while True:
            path.append(node.name)
            if not node.children:
                return self.predict(node, penalties)
            step, answer = self.first_child_that_counts(node, case)
            path.append(answer)
            if answer == FALSE:
                return self.predict(node, penalties) if self.last_without_true_child else None
            if answer == UNKNOWN and self.strategy == "defaultChild":
                step = next(child for child in node.children if child.name == node.default_child)
            elif answer == UNKNOWN:
                return self.predict_undecided(node, case, path, penalties)
            if answer != TRUE:
                penalties += 1
            node = step

    def first_child_that_counts(self, node, case):
        for child in node.children:
            answer = child.predicate(case)
            if answer in (TRUE, SURROGATE) or (answer == UNKNOWN and self.strategy != "none"):
                return child, answer
        return None, FALSE

    def predict_undecided(self, node, case, path, penalties):
        if self.strategy == "nullPrediction":
            return None
        if self.strategy == "lastPrediction":
            return self.predict(node, penalties)
        if self.strategy == "weightedConfidence":
            return self.weigh(node, case, path)
        leaves = []
        self.collect_leaves(node, case, path, leaves)
        return self.aggregate(leaves)

    def predict(self, node, penalties):
        if self.is_regression:
            return None if node.score is None else Outcome(float(node.score), node.name)
        if node.score is None and not node.entries:
            return None
        counts = node.counts()
        outcome = Outcome(node.score or first_highest(counts, counts), node.name)
        outcome.probabilities = node.probabilities()
        outcome.confidences = node.confidences()
        outcome.confidence = outcome.confidences[outcome.prediction]
        for _ in range(penalties):
            outcome.confidence *= self.penalty
        return outcome

    def possible_children(self, node, case):
        return [child for child in node.children if child.predicate(case) != FALSE]

    def weigh(self, node, case, path):
        parts = [(child, self.descend(child, case, path, 0)) for child in self.possible_children(node, case)]
        parts = [(child, outcome) for child, outcome in parts if outcome is not None]
        if not parts:
            return None
        total = sum(child.record_count for child, outcome in parts)
        contributors = sum(outcome.contributors for child, outcome in parts)
        if self.is_regression:
            value = sum(child.record_count / total * outcome.prediction for child, outcome in parts)
            return self.joined(value, contributors)
        sums = {}
        for child, outcome in parts:
            for category, confidence in outcome.confidences.items():
                sums[category] = sums.get(category, 0.0) + child.record_count / total * confidence
        joined = self.joined_shares(sums, contributors)
        if any(outcome.confidences != outcome.probabilities for child, outcome in parts):
            joined.probabilities = None
        return joined

    def collect_leaves(self, node, case, path, leaves):
        path.append(node.name)
        child, answer = self.first_child_that_counts(node, case)
        path.append(answer)
        if not node.children:
            leaves.append(node)
        elif answer in (TRUE, SURROGATE):
            self.collect_leaves(child, case, path, leaves)
        elif answer == UNKNOWN:
            for possible in self.possible_children(node, case):
                self.collect_leaves(possible, case, path, leaves)
        elif self.last_without_true_child:
            leaves.append(node)

    def aggregate(self, leaves):
        if not leaves:
            return None
        if self.is_regression:
            total = sum(leaf.record_count for leaf in leaves)
            return self.joined(sum(leaf.record_count * float(leaf.score) for leaf in leaves) / total, len(leaves))
        sums = {}
        for leaf in leaves:
            for category, count in leaf.counts().items():
                sums[category] = sums.get(category, 0.0) + count
        total = sum(sums.values())
        return self.joined_shares({category: count / total for category, count in sums.items()}, len(leaves))

    @staticmethod
    def joined(value, contributors):
        outcome = Outcome(value, "?" if contributors == 1 else "")
        outcome.contributors = contributors
        return outcome

    def joined_shares(self, shares, contributors):
        outcome = self.joined(first_highest(shares, self.target.categories), contributors)
        outcome.probabilities = outcome.confidences = shares
        outcome.confidence = shares[outcome.prediction]
        return outcome

    def answer_header(self):
        if self.is_regression:
            return ["prediction", "node"]
        return ["prediction", "probability"] + [f"probability_{name}" for name in self.target.categories] + ["node"]

    def answer_cells(self, outcome):
        if outcome is None:
            return [""] * len(self.answer_header())
        if self.is_regression:
            return [repr(outcome.prediction), outcome.node]
        if outcome.probabilities is None:
            shares = [""] * len(self.target.categories)
        else:
            shares = [repr(outcome.probabilities.get(category, 0.0)) for category in self.target.categories]
        return [outcome.prediction, repr(outcome.confidence)] + shares + [outcome.node]


def main(model, cases):
    tree = Tree(model)
    out = csv.writer(sys.stdout, lineterminator="\n")
    out.writerow(tree.answer_header())
    with open(cases, encoding="utf-8", newline="") as table:
        for row in csv.DictReader(table):
            case = {name: field.value_of(row[name]) for name, field in tree.fields.items()}
            out.writerow(tree.answer_cells(tree.score(case)))


if __name__ == "__main__":
    main(*sys.argv[1:])
