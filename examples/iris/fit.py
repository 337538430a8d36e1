#!/usr/bin/env python3
"""Fits a multinomial logistic regression to Fisher's iris data with scikit-learn (Debian: python3-sklearn)."""
import os
import sys

from sklearn.datasets import load_iris
from sklearn.linear_model import LogisticRegression

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml

data = load_iris()
inputs = [name.replace(" (cm)", "").replace(" ", "_") for name in data.feature_names]
species = [str(name) for name in data.target_names]
fitted = LogisticRegression(max_iter=10000, tol=1e-10).fit(data.data, data.target)

model = pmml.Model("iris species by flower measurements", inputs, "species", species, "softmax")
for category, intercept, coefficients in zip(species, fitted.intercept_, fitted.coef_):
    model.add_table(intercept, coefficients, category)
model.write(pmml.here(__file__, "model.xml"))

pmml.write_table(pmml.here(__file__, "data.csv"), inputs + ["species"],
                 [list(row) + [species[kind]] for row, kind in zip(data.data, data.target)])
chances = fitted.predict_proba(data.data)
pmml.write_table(pmml.here(__file__, "expected.csv"),
                 ["prediction", "probability"] + ["probability_" + name for name in species],
                 [[species[row.argmax()], row.max()] + list(row) for row in chances])
