#!/usr/bin/env python3
"""Fits a pipeline, standardised inputs and a multinomial logistic regression, to the wine data with scikit-learn
(Debian: python3-sklearn)."""
import os
import sys

from sklearn.datasets import load_wine
from sklearn.linear_model import LogisticRegression
from sklearn.pipeline import make_pipeline
from sklearn.preprocessing import StandardScaler

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml

data = load_wine()
inputs = [str(name).replace("/", "_") for name in data.feature_names]
growers = ["grower_" + str(kind + 1) for kind in range(3)]
fitted = make_pipeline(StandardScaler(), LogisticRegression(max_iter=10000, tol=1e-10)).fit(data.data, data.target)

# The document has no step before the regression: w * (x - mean) / scale is (w / scale) * x and a part of the intercept.
scaler, regression = fitted[0], fitted[1]
model = pmml.Model("grower of a wine by its chemistry", inputs, "grower", growers, "softmax")
for grower, intercept, weights in zip(growers, regression.intercept_, regression.coef_):
    coefficients = weights / scaler.scale_
    model.add_table(intercept - coefficients @ scaler.mean_, coefficients, grower)
model.write(pmml.here(__file__, "model.xml"))

pmml.write_table(pmml.here(__file__, "data.csv"), inputs + ["grower"],
                 [list(row) + [growers[kind]] for row, kind in zip(data.data, data.target)])
chances = fitted.predict_proba(data.data)
pmml.write_table(pmml.here(__file__, "expected.csv"),
                 ["prediction", "probability"] + ["probability_" + name for name in growers],
                 [[growers[row.argmax()], row.max()] + list(row) for row in chances])
