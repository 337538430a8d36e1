#!/usr/bin/env python3
"""Fits a linear regression of diabetes progression on ten inputs with scikit-learn (Debian: python3-sklearn)."""
import os
import sys

from sklearn.datasets import load_diabetes
from sklearn.linear_model import LinearRegression

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml

data = load_diabetes(scaled=False)
inputs = list(data.feature_names)
fitted = LinearRegression().fit(data.data, data.target)

model = pmml.Model("diabetes progression after one year", inputs, "progression")
model.add_table(fitted.intercept_, fitted.coef_)
model.write(pmml.here(__file__, "model.xml"))

pmml.write_table(pmml.here(__file__, "data.csv"), inputs + ["progression"],
                 [list(row) + [target] for row, target in zip(data.data, data.target)])
pmml.write_table(pmml.here(__file__, "expected.csv"), ["prediction"], [[y] for y in fitted.predict(data.data)])
