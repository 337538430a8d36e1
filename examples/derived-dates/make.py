#!/usr/bin/env python3
"""What model.xml derives from the crewed Apollo flights, in plain Python. Launches and splashdowns are in universal
time."""
import datetime
import os
import sys

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "fit"))
import derived

FLIGHTS = """
Apollo 7,1968-10-11T15:02:45,1968-10-22T11:11:48
Apollo 8,1968-12-21T12:51:00,1968-12-27T15:51:42
Apollo 9,1969-03-03T16:00:00,1969-03-13T17:00:54
Apollo 10,1969-05-18T16:49:00,1969-05-26T16:52:23
Apollo 11,1969-07-16T13:32:00,1969-07-24T16:50:35
Apollo 12,1969-11-14T16:22:00,1969-11-24T20:58:24
Apollo 13,1970-04-11T19:13:00,1970-04-17T18:07:41
Apollo 14,1971-01-31T21:03:02,1971-02-09T21:05:00
Apollo 15,1971-07-26T13:34:00,1971-08-07T20:45:53
Apollo 16,1972-04-16T17:54:00,1972-04-27T19:45:05
Apollo 17,1972-12-07T05:33:00,1972-12-19T19:24:59
not known,,
"""
EPOCH = datetime.datetime(1970, 1, 1)
LANDING = datetime.datetime(1969, 7, 20, 20, 17, 40)


def moment(text):
    return datetime.datetime.fromisoformat(text) if text else None


def seconds(later, earlier):
    return (later - earlier).total_seconds()


def day_of(time):
    """Days are counted from 1970 and cut toward zero, so that before it a day begins with its second second and ends
    with the midnight behind it: 1968-10-11T15:02:45 is in the day that ends at 1968-10-12T00:00:00."""
    return EPOCH + datetime.timedelta(days=int(seconds(time, EPOCH) / 86400))


def derive(row):
    launched, recovered = moment(row["launched"]), moment(row["recovered"])
    names = ["days", "hours", "minutes", "seconds", "months after the first landing", "years after the first landing",
             "year", "month", "day", "hour", "minute", "second", "later"]
    if launched is None:
        return dict.fromkeys(names[:-1]) | {"later": LANDING.isoformat()}
    flight, after, day = seconds(recovered, launched), seconds(launched, LANDING), day_of(launched)
    return dict(zip(names, [
        flight / 86400, flight / 3600, flight / 60, flight, after / 86400 / 30.4375, after / 86400 / 365.25,
        day.year, day.month, day.day, launched.hour, launched.minute, launched.second,
        max(launched, LANDING).isoformat()]))


flights = [dict(zip(["mission", "launched", "recovered"], line.split(","))) for line in FLIGHTS.split("\n") if line]
derived.write(__file__, flights, derive)
