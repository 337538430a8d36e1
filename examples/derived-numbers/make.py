#!/usr/bin/env python3
"""What model.xml derives from Fisher's iris measurements, in plain Python."""
import math
import os
import sys

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import derived


def round_half_up(x):
    return math.floor(x + 0.5)


def derive(row):
    sepal_length, sepal_width, petal_length, petal_width = (float(text) for text in row.values())
    difference = sepal_width - petal_length
    return {
        "length of both": sepal_length + petal_length,
        "sepal squared": sepal_width ** 2,
        "inverse cube": petal_length ** -3,
        "distance": abs(difference),
        "growth": math.exp(petal_width),
        "digits": math.log10(petal_length),
        "digits again": math.log10(petal_length),
        "log ratio": math.log(sepal_length / sepal_width),
        "log of nothing": -99,
        "rest": math.fmod(sepal_length * 10, 7),
        "rounded": round_half_up(sepal_length),
        "side": math.sqrt(petal_length * petal_width),
        "cut": math.trunc(difference),
        "below": math.floor(difference),
        "above": math.ceil(difference),
        "share of normal": math.erfc(-(sepal_length - 5.8433) / 0.828 / math.sqrt(2)) / 2,
        "is wide": petal_width > 0.8,
    }


columns = ["sepal_length", "sepal_width", "petal_length", "petal_width"]
derived.write(__file__, derived.rows_of("iris", columns), derive)
