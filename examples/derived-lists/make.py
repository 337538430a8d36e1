#!/usr/bin/env python3
"""What model.xml derives from the chemistry of wines, in plain Python."""
import statistics
import os
import sys

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import derived


def derive(row):
    alcohol, malic_acid, ash, _, phenols, flavanoids, proline = (float(text) for text in row.values())
    four = [malic_acid, ash, phenols, flavanoids]
    normal = statistics.NormalDist(13.0006, 0.8118)
    return {
        "difference": phenols - flavanoids,
        "product of two": alcohol * proline,
        "ratio": flavanoids / phenols,
        "no ratio": 0,
        "total": sum(four),
        "mean": sum(four) / 4,
        "average": (malic_acid + flavanoids) / 2,
        "least": min(four),
        "most": max(four),
        "middle": statistics.median(four),
        "middle of three": statistics.median(four[:3]),
        "all multiplied": malic_acid * ash * phenols,
        "spread": statistics.stdev(four),
        "spread squared": statistics.variance(four),
        "probability": normal.cdf(alcohol),
        "density": normal.pdf(alcohol),
        "back again": alcohol,
    }


columns = ["alcohol", "malic_acid", "ash", "magnesium", "total_phenols", "flavanoids", "proline"]
derived.write(__file__, derived.rows_of("wine", columns), derive)
