"""Random data fields for make_documents.py, and the values that go with them."""
from xml.sax.saxutils import quoteattr

from values import DATE_TYPES, DATES, DAY, MISSING, MOMENT, NUMBER, TEXT, TIMES, Moment, moment_from_number, text_of

NUMBERS = [-1000.0, -99.0, -7.0, -3.0, -2.5, -1.5, -1.0, -0.5, 0.0, 0.1, 0.5, 1.0, 1.5, 2.0, 2.5, 3.0, 3.75, 7.0,
           10.0, 12.25,
           40.0, 100.0, 365.25, 12345.678, 1e6, 1e-5]
STRANGE_NUMBERS = [709.5, -708.0, -709.5, 2147483646.5, -2147483648.0, 3e9, 1e20, 1.7e308, -1.7e308, 1e-300]
WHOLE_NUMBERS = [x for x in NUMBERS if x == int(x)] + [4.0, 5.0, 6.0, 8.0, 9.0]
MISSING_CODES = [-99.0, 999.0, 7.0]
# What documents say, and so without blanks at either end.
WORDS = ["red", "green", "light blue", "Zoë", "UPPER", "Mixed Case", "12", "3.5", "7 up", "-4e2", "salt & pepper",
         "<none>", "can't say", "Straße", "x", "abcdefghij", "n/a"]
# What cases hold besides.
OTHER_TEXTS = ["", " ", "red ", " red", "Red", "\ttab and blank \t", "  1.25", "5e", "1e400", "inf", "none of them",
               "Zoë  "]
# Texts that constants may hold, but nothing else.
NO_MOMENTS = ["2013-13-01", "24:00:00", "12:30", "1970-01-01 01:00:00", "never"]
CALENDAR = [(1970, 1, 1), (1969, 12, 31), (1960, 2, 29), (2000, 2, 29), (1900, 3, 1), (2024, 12, 31), (1582, 10, 15),
            (1, 1, 1)]
CLOCK = [0, 1, 59, 60, 3599, 3600, 43200, 86399]


class RandomField:
    """A data or derived field. `literals` are texts for a document that stand for likely values; `values` what cases
    hold."""

    def __init__(self, name, data_type, optype):
        self.name, self.data_type, self.optype = name, data_type, optype
        self.kind = TEXT if data_type == "string" else MOMENT if data_type in DATE_TYPES else NUMBER
        self.literals, self.values = [], []
        self.has_labels = self.is_derived = False

    def literal(self, rng):
        return rng.choice(self.literals) if rng.random() < 0.8 else random_literal(rng, self.data_type)

    def value(self, rng):
        return rng.choice(self.values)


def written_number(x):
    return str(int(x)) if x == int(x) and abs(x) < 1e15 else repr(x)


def written_moment(rng, data_type):
    """A text of a type."""
    date = "%d-%02d-%02d" % rng.choice(CALENDAR)
    seconds = rng.choice(CLOCK)
    time = "%02d:%02d:%02d" % (seconds // 3600, seconds // 60 % 60, seconds % 60)
    if data_type in ("date", "time", "dateTime"):
        return {"date": date, "time": time, "dateTime": date + "T" + time}[data_type]
    return written_number(random_count(rng, data_type))


def random_count(rng, data_type):
    """A number in the unit of a date/time type."""
    _, shift, unit = DATE_TYPES[data_type]
    if data_type in TIMES:
        return float(rng.choice(CLOCK))
    days = rng.choice([-5000, -1, 0, 1, 59, 60, 366, 10957, 20000])
    seconds = 0 if data_type in DATES else rng.choice(CLOCK + [0.5])
    return (days * DAY + seconds) / unit - shift


def random_moment(rng, data_type):
    if data_type in TIMES:
        return Moment(float(rng.choice(CLOCK)), data_type)
    return moment_from_number(random_count(rng, data_type), data_type)


def random_literal(rng, data_type):
    if data_type == "string":
        return rng.choice(WORDS)
    if data_type in DATE_TYPES:
        return written_moment(rng, data_type)
    return written_number(rng.choice(WHOLE_NUMBERS if data_type == "integer" else NUMBERS))


def random_value(rng, data_type):
    """A value of a case, present."""
    if data_type == "string":
        return text_of(rng.choice(WORDS + OTHER_TEXTS))
    if data_type in DATE_TYPES:
        return random_moment(rng, data_type)
    if data_type == "integer":
        return rng.choice(WHOLE_NUMBERS)
    draw = rng.random()
    if draw < 0.08:
        return rng.choice(STRANGE_NUMBERS)
    return rng.choice(NUMBERS) if draw < 0.7 else round(rng.gauss(0, 50), 3)


def value_element(text, role=None):
    return f"<Value value={quoteattr(text)}" + (f' property="{role}"' if role else "") + "/>"


def random_interval(rng, low, high):
    closure = rng.choice(["closedClosed", "closedOpen", "openClosed", "openOpen"])
    margins = [f'leftMargin="{written_number(low)}"', f'rightMargin="{written_number(high)}"']
    if rng.random() < 0.3:
        margins.pop(rng.randrange(2))
    return f'<Interval closure="{closure}" {" ".join(margins)}/>'


def random_data_field(rng, name, data_type):
    """The field and its element."""
    is_listed = data_type == "string" or data_type in ("double", "integer") and rng.random() < 0.3
    optype = rng.choice(["categorical", "ordinal"]) if is_listed else "continuous"
    field = RandomField(name, data_type, optype)
    children = []
    field.values = [random_value(rng, data_type) for _ in range(8)]
    if field.kind == NUMBER:
        children = number_children(rng, field)
    elif field.kind == TEXT:
        children = text_children(rng, field)
    else:
        field.literals = [written_moment(rng, data_type) for _ in range(4)]
        if rng.random() < 0.3:
            code = random_count(rng, data_type)
            children.append(value_element(written_number(code), rng.choice(["missing", "invalid"])))
            field.values.append(moment_from_number(code, data_type))
    return field, element("DataField", field, children)


def number_children(rng, field):
    children = []
    if field.optype != "continuous":
        field.has_labels = True
        labels = rng.sample(WHOLE_NUMBERS[4:], 4)
        children += [value_element(written_number(label)) for label in labels]
        field.values = labels * 2 + field.values[:3]
        if rng.random() < 0.4:
            code = next(x for x in WHOLE_NUMBERS if x not in labels)
            children.append(value_element(written_number(code), "missing"))
            field.values.append(code)
        elif rng.random() < 0.5:
            # Labels inside it stand and win.
            children.append('<Extension name="invalidRangeLower" value="0"/>')
            children.append('<Extension name="invalidRangeUpper" value="8"/>')
    else:
        draw = rng.random()
        if draw < 0.4:
            code = rng.choice(MISSING_CODES)
            children.append(value_element(written_number(code), rng.choice(["missing", "invalid"])))
            field.values += [code, code]
        elif draw < 0.6:
            children.append(random_interval(rng, rng.choice([-1000.0, -3.0, 0.0]), rng.choice([3.0, 10.0, 100.0])))
        elif draw < 0.7:
            children.append('<Extension name="invalidRangeLower" value="10"/>')
    field.literals = [written_number(value) for value in field.values if value == value and abs(value) < 1e15]
    return children


def text_children(rng, field):
    children = []
    words = rng.sample(WORDS, 5)
    if rng.random() < 0.7:
        field.has_labels = True
        children += [value_element(word) for word in words[:4]]
    if rng.random() < 0.5:
        children.append(value_element(words[4], rng.choice(["missing", "invalid"])))
    field.literals = words
    field.values = [text_of(word) for word in words] * 2 + [text_of(word) for word in rng.sample(OTHER_TEXTS, 4)]
    return children


def element(tag, field, children, attributes=""):
    opening = f'<{tag} name={quoteattr(field.name)} optype="{field.optype}" dataType="{field.data_type}"{attributes}'
    if not children:
        return opening + "/>"
    return f"{opening}>{''.join(children)}</{tag}>"


def missing_value(kind, data_type):
    return text_of("") if kind == TEXT else MISSING if kind == NUMBER else Moment(MISSING, data_type)
