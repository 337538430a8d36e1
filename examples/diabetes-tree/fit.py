#!/usr/bin/env python3
"""Fits a deep regression tree of diabetes progression on ten inputs with scikit-learn (Debian: python3-sklearn)."""
import os
import sys

import numpy
from sklearn.datasets import load_diabetes
from sklearn.tree import DecisionTreeRegressor

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml

data = load_diabetes(scaled=False)
inputs = list(data.feature_names)
# scikit-learn compares single precision inputs with thresholds of double precision, so the table has what it sees.
patients = data.data.astype(numpy.float32)
fitted = DecisionTreeRegressor(min_samples_leaf=2, random_state=0).fit(patients, data.target)

pmml.RegressionTree("diabetes progression after one year, by a tree", inputs, "progression", fitted).write(
    pmml.here(__file__, "model.xml"))
pmml.write_table(pmml.here(__file__, "data.csv"), inputs + ["progression"],
                 [list(row) + [target] for row, target in zip(patients, data.target)])
pmml.write_table(pmml.here(__file__, "expected.csv"), ["prediction"], [[y] for y in fitted.predict(patients)])
