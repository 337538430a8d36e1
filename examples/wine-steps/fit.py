#!/usr/bin/env python3
"""Fits a classification tree on computed inputs to the wine data with scikit-learn (Debian: python3-sklearn): a
logarithm, a quotient, a standardised number and a number in bins that have an order."""
import os
import sys

import numpy
from sklearn.compose import make_column_transformer
from sklearn.datasets import load_wine
from sklearn.pipeline import make_pipeline
from sklearn.preprocessing import FunctionTransformer, KBinsDiscretizer, StandardScaler
from sklearn.tree import DecisionTreeClassifier

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml
import steps

data = load_wine()
inputs = ["proline", "color_intensity", "hue", "malic_acid", "alcohol", "flavanoids"]
columns = [list(data.feature_names).index(name) for name in inputs]
wines = data.data[:, columns]
growers = ["grower_" + str(kind + 1) for kind in range(3)]

computed = make_column_transformer(
    (FunctionTransformer(numpy.log), [0]),
    (FunctionTransformer(lambda both: both[:, :1] / both[:, 1:]), [1, 2]),
    (StandardScaler(), [3]),
    (KBinsDiscretizer(6, encode="ordinal", strategy="quantile"), [4]),
    (KBinsDiscretizer(3, encode="ordinal", strategy="uniform"), [5]))
fitted = make_pipeline(computed, DecisionTreeClassifier(min_samples_leaf=2, random_state=0)).fit(wines, data.target)

scaler = fitted[0].transformers_[2][1]
edges = [fitted[0].transformers_[number][1].bin_edges_[0] for number in (3, 4)]
labels = [[name + str(number + 1) for number in range(len(of_field) - 1)]
          for name, of_field in zip(("strength", "level"), edges)]
model = steps.Pipeline(
    "grower of a wine, by a tree on computed inputs", dict.fromkeys(inputs), "grower", growers, (),
    [steps.function("log_proline", "ln", "proline"),
     steps.bins("alcohol_bin", "alcohol", edges[0], labels[0], "ordinal")],
    [steps.function("depth_of_color", "/", "color_intensity", "hue"),
     steps.standard_scaler("malic_scaled", "malic_acid", scaler.mean_[0], scaler.scale_[0]),
     steps.bins("flavanoids_bin", "flavanoids", edges[1], labels[1], "ordinal")])


def number(name):
    return lambda threshold: [f'<SimplePredicate field="{name}" operator="{operator}" value="{threshold!r}"/>'
                              for operator in ("lessOrEqual", "greaterThan")]


def ordered(name, of_field):
    return lambda threshold: [
        f'<SimplePredicate field="{name}" operator="{operator}" value="{of_field[int(threshold)]}"/>'
        for operator in ("lessOrEqual", "greaterThan")]


model.write_tree(pmml.here(__file__, "model.xml"), fitted[1], [
    number("log_proline"), number("depth_of_color"), number("malic_scaled"), ordered("alcohol_bin", labels[0]),
    ordered("flavanoids_bin", labels[1])])
pmml.write_table(pmml.here(__file__, "data.csv"), inputs + ["grower"],
                 [list(row) + [growers[kind]] for row, kind in zip(wines, data.target)])
model.write_answers(__file__, fitted.predict_proba(wines))
