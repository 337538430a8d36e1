#!/usr/bin/env python3
"""What model.xml derives from every fourth passenger of the Titanic, in plain Python. An age that is not known counts
as less than every other."""
import os
import sys

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import derived


def derive(row):
    sex, age, passenger_class, survived = row.values()
    years = derived.number(age)
    known = float("-inf") if years is None else years
    return {
        "is male": sex == "male",
        "is not male": sex != "male",
        "is 30": years == 30,
        "is a child": known < 15,
        "is up to 15": known <= 15,
        "is over 60": known > 60,
        "is 60 or older": known >= 60,
        "is in a cabin": passenger_class in ("1st", "2nd"),
        "is in steerage": passenger_class not in ("1st", "2nd"),
        "has a round age": years in (20, 30, 40, 50, 60),
        "age is known": years is not None,
        "class is unknown": passenger_class == "",
        "is a boy": sex == "male" and known < 15 and years is not None,
        "goes first": sex == "female" or known < 15,
        "was lost": survived != "yes",
        "is of age": known > 21,
    }


derived.write(__file__, derived.rows_of("titanic-tree", ["sex", "age", "passengerClass", "survived"], 4), derive)
