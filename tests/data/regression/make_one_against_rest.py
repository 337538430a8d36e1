#!/usr/bin/env python3
"""Fits one logistic regression a species against the others to Fisher's iris data with scikit-learn 1.2 (Debian:
python3-sklearn). Writes the document one_against_rest.xml and, for every seventh flower, its measurements and
scikit-learn's probabilities to one_against_rest.csv.

scikit-learn divides each equation's probability by the sum of the three.
"""
import os
import sys

from sklearn.datasets import load_iris
from sklearn.linear_model import LogisticRegression

HERE = os.path.dirname(os.path.abspath(__file__))
sys.path.insert(0, os.path.join(HERE, "..", "..", "..", "examples", "fit"))
import pmml

data = load_iris()
inputs = [name.replace(" (cm)", "").replace(" ", "_") for name in data.feature_names]
species = [str(name) for name in data.target_names]
fitted = LogisticRegression(multi_class="ovr", max_iter=10000, tol=1e-10).fit(data.data, data.target)

model = pmml.Model("iris species, each against the rest", inputs, "species", species, "logit")
for category, intercept, coefficients in zip(species, fitted.intercept_, fitted.coef_):
    model.add_table(intercept, coefficients, category)
model.write(pmml.here(__file__, "one_against_rest.xml"))

flowers = data.data[::7]
pmml.write_table(pmml.here(__file__, "one_against_rest.csv"), inputs + species,
                 [list(row) + list(chances) for row, chances in zip(flowers, fitted.predict_proba(flowers))])
