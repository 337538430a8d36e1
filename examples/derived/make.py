#!/usr/bin/env python3
"""What model.xml derives from the survey of the example `students`, in plain Python."""
import os
import sys

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import derived


def curve(height):
    if height <= 170:
        return 1 + (height - 160) * 0.05
    return 1.5 + (height - 170) * 0.025


def band(height):
    if height is None:
        return "unknown"
    return "short" if height < 165 else "medium" if height < 180 else "tall"


def derive(row):
    pulse = derived.number(row["Pulse"]) or 72.0
    height = derived.number(row["Height"])
    calm = min(max(pulse, 50), 100)
    exercise = {"None": 0, "Some": 2, "Freq": 5}[row["Exer"]]
    return {
        "where": "Adelaide",
        "pulse": pulse,
        "height score": 1.5 if height is None else min(max(1 + (height - 160) / 30, 1), 2),
        "height curve": None if height is None else curve(height),
        "never smoked": None if row["Smoke"] == "" else row["Smoke"] == "Never",
        "height band": band(height),
        "calm pulse": calm,
        "exercise": exercise,
        "smoker": "" if row["Smoke"] == "" else {"Never": "no", "Occas": "hardly"}.get(row["Smoke"], "yes"),
        "load": -1 if height is None else calm * exercise / height,
    }


derived.write(__file__, derived.rows_of("students", ["Wr.Hnd", "Pulse", "Height", "W.Hnd", "Exer", "Smoke"]), derive)
