#!/usr/bin/env python3
"""Fits a logistic regression behind a pipeline of steps to the passengers of titanic-tree with scikit-learn (Debian:
python3-sklearn): what is missing is filled in, categories become indicators and ranks, the age is standardised and
put into bins."""
import csv
import os
import shutil
import sys

import numpy
from sklearn.compose import make_column_transformer
from sklearn.impute import SimpleImputer
from sklearn.linear_model import LogisticRegression
from sklearn.pipeline import make_pipeline
from sklearn.preprocessing import KBinsDiscretizer, OneHotEncoder, OrdinalEncoder, StandardScaler

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import pmml
import steps

source = pmml.here(__file__, "../titanic-tree/data.csv")
with open(source, encoding="utf-8", newline="") as data:
    passengers = list(csv.DictReader(data))
sexes, classes, survived = ["female", "male"], ["1st", "2nd", "3rd"], ["no", "yes"]
texts = numpy.array([[row["sex"] or numpy.nan, row["passengerClass"] or numpy.nan] for row in passengers],
                    dtype=object)
ages = numpy.array([[float(row["age"] or "nan")] for row in passengers])
cases = numpy.hstack([texts, ages])
target = [row["survived"] for row in passengers]

most_frequent = lambda: SimpleImputer(strategy="most_frequent")
columns = make_column_transformer(
    (make_pipeline(most_frequent(), OneHotEncoder(categories=[sexes], sparse_output=False)), [0]),
    (make_pipeline(most_frequent(), OrdinalEncoder(categories=[classes])), [1]),
    (make_pipeline(SimpleImputer(), StandardScaler()), [2]),
    (make_pipeline(SimpleImputer(), KBinsDiscretizer(5, encode="onehot-dense", strategy="quantile")), [2]),
    sparse_threshold=0)
fitted = make_pipeline(columns, LogisticRegression(max_iter=10000, tol=1e-10)).fit(cases, target)

sex_step, class_step, age_step, bin_step = (step for _, step, _ in fitted[0].transformers_[:4])
scaler, bin_edges = age_step[1], bin_step[1].bin_edges_[0]
labels = ["age" + str(number + 1) for number in range(len(bin_edges) - 1)]
model = steps.Pipeline(
    "survival on the Titanic, by a pipeline", {"sex": sexes, "age": None, "passengerClass": classes}, "survived",
    survived,
    {"sex": sex_step[0].statistics_[0], "passengerClass": class_step[0].statistics_[0],
     "age": repr(float(age_step[0].statistics_[0]))},
    [steps.indicator("is_female", "sex", "female"), steps.indicator("is_male", "sex", "male"),
     steps.table("class_rank", "passengerClass", {name: rank for rank, name in enumerate(classes)})],
    [steps.standard_scaler("age_scaled", "age", scaler.mean_[0], scaler.scale_[0]),
     steps.bins("age_bin", "age", bin_edges, labels)])
weights = fitted[1].coef_[0]
terms = [("is_female", None, weights[0]), ("is_male", None, weights[1]), ("class_rank", None, weights[2]),
         ("age_scaled", None, weights[3])]
terms += [("age_bin", label, weight) for label, weight in zip(labels, weights[4:])]
model.write_regression(pmml.here(__file__, "model.xml"), "yes", fitted[1].intercept_[0], terms)

shutil.copyfile(source, pmml.here(__file__, "data.csv"))
model.write_answers(__file__, fitted.predict_proba(cases))
