#!/usr/bin/env python3
"""Finds the centroids of Fisher's iris data with scikit-learn (Debian: python3-sklearn).

The predictions are scikit-learn's, the probabilities plain Python's.
"""
import math
import os
import sys

from sklearn.datasets import load_iris
from sklearn.neighbors import NearestCentroid

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "..", "examples", "fit"))
import pmml


class CentroidModel(pmml.Document):
    """The model element of this folder's plug-in, which is not one of PMML's."""

    centroids = []  # (category, coordinates)

    def model_lines(self):
        yield f'  <CentroidModel functionName="{self.function()}">'
        yield from self.mining_schema_lines()
        for category, coordinates in self.centroids:
            yield f'    <Centroid category="{category}">'
            for name, value in zip(self.inputs, coordinates):
                yield f'      <Coordinate field="{name}" value="{value!r}"/>'
            yield "    </Centroid>"
        yield "  </CentroidModel>"


data = load_iris()
flowers = data.data[:, 2:].tolist()
species = [str(name) for name in data.target_names]
fitted = NearestCentroid().fit(flowers, data.target)

model = CentroidModel("iris species by the nearest centroid", ["petal_length", "petal_width"], "species", species)
model.centroids = list(zip(species, fitted.centroids_.tolist()))
model.write(pmml.here(__file__, "model.xml"))

pmml.write_table(pmml.here(__file__, "data.csv"), model.inputs + ["species"],
                 [flower + [species[kind]] for flower, kind in zip(flowers, data.target)])
rows = []
for flower, kind in zip(flowers, fitted.predict(flowers)):
    squares = [math.fsum((x - c) ** 2 for x, c in zip(flower, centroid)) for _, centroid in model.centroids]
    densities = [math.exp(-square / 2) for square in squares]
    shares = [density / math.fsum(densities) for density in densities]
    rows.append([species[kind], shares[kind]] + shares)
pmml.write_table(pmml.here(__file__, "expected.csv"),
                 ["prediction", "probability"] + ["probability_" + name for name in species], rows)
