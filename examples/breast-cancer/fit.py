#!/usr/bin/env python3
"""Fits a logistic regression to the Wisconsin breast cancer data with scikit-learn (Debian: python3-sklearn)."""
import os
import sys

import numpy
from scipy.special import expit
from sklearn.datasets import load_breast_cancer
from sklearn.linear_model import LogisticRegression

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml

data = load_breast_cancer()
inputs = [str(name).replace(" ", "_") for name in data.feature_names]
diagnoses = [str(name) for name in data.target_names]  # malignant, benign
fitted = LogisticRegression(solver="newton-cg", max_iter=1000).fit(data.data, data.target)

# scikit-learn's one equation is for the second class; the first is the reference with a table of its own.
model = pmml.Model("breast cancer diagnosis", inputs, "diagnosis", diagnoses, "logit")
model.add_table(fitted.intercept_[0], fitted.coef_[0], diagnoses[1])
model.add_table(0.0, [], diagnoses[0])
model.write(pmml.here(__file__, "model.xml"))

pmml.write_table(pmml.here(__file__, "data.csv"), inputs + ["diagnosis"],
                 [list(row) + [diagnoses[kind]] for row, kind in zip(data.data, data.target)])
# predict_proba() takes the first class's chance from 1, which costs a small chance its digits; SciPy's own function does not.
score = fitted.decision_function(data.data)
chances = numpy.stack([expit(-score), expit(score)], axis=1)
pmml.write_table(pmml.here(__file__, "expected.csv"),
                 ["prediction", "probability"] + ["probability_" + name for name in diagnoses],
                 [[diagnoses[row.argmax()], row.max()] + list(row) for row in chances])
