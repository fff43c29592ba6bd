"""Finds all changes of one token that the plug-in's sources allow."""

import dataclasses
import itertools
import re

from one_token.tokens import CLOSING, CONTROL, Source

OPERATORS = {
    "==": ["!="], "!=": ["=="], "<": ["<=", ">="], "<=": ["<", ">"], ">": [">=", "<="],
    ">=": [">", "<"], "&&": ["||"], "||": ["&&"], "+": ["-"], "-": ["+"], "*": ["/"], "/": ["*"],
    "<<": ["<="], "+=": ["-="],
}
LOGICAL = {"&&", "||"}
COMPARISONS = {"==", "!=", "<", "<=", ">", ">="}

# Constants that fit in each other's places.
FAMILIES = [re.compile(pattern) for pattern in (
    r"VAHAEntityType\w+Value", r"VAHAActionType\w+Value", r"VAHAActionOutcome\w+Value",
    r"VAHACommandOutcome\w+Value", r"VAHAAttribute\w+Value", r"NDCharacteristicMetadataFormat\w+",
    r"NDCharacteristicMetadataUnits\w+", r"NDCharacteristicProperty\w+", r"kNDError\w+",
    r"kObject\w+Key",
)]

# Names that stand for the opposite, or for a neighbour.
PAIRS = [
    ("minimumValue", "maximumValue"), ("stepValue", "minimumValue"), ("is_lt", "is_lteq"),
    ("is_gt", "is_gteq"), ("front", "back"), ("min", "max"),
    ("mapReadCharcteristicFromAssistantName", "mapWriteCharcteristicFromAssistantName"),
    ("mapToAssistantCharacteristicValue_name", "mapFromAssistantCharacteristicValue_name"),
    ("mapToAssistantUnitName", "mapFromAssistantUnitName"),
    ("mapToAssistantServiceName", "mapFromAssistantServiceName"),
    ("fahrenheitToCelsius", "celsiusToFahrenheit"), ("outcomeOfRead", "outcomeOfWrite"),
]

# Functions that take their two arguments in either order.
SYMMETRIC = {"isEqual", "isEqualButDiacritics", "isEqualIgnoringDiacritics", "holdSameValue",
             "min", "max"}

# A statement that sets one thing, and one that makes a variable without a value.
SETTING = re.compile(r"(?:(?:\w+(?:\.|->))*(?P<field>\w+) \+?= .*"
                     r"|(?:\w+(?:\.|->))*set(?P<property>(?!If|Unless)[A-Z]\w*)\(.*\)"
                     r"|(?P<swapped>\w+)\.swap\((?P<other>\w+)\));", re.DOTALL)
MAKING = re.compile(r"(?!const|return)[\w:<>]+ (?P<variable>\w+);")


@dataclasses.dataclass(frozen=True)
class Change:
    """A piece of a file that is replaced; `alternatives` are tried until one compiles."""

    file: str
    start: int
    before: str
    alternatives: tuple
    kind: str
    line: int
    column: int
    source_line: str

    def name(self):
        before, after = one_line(self.before), one_line(self.alternatives[0])
        return f"{self.file}:{self.line}:{self.column}: {self.kind}: `{before}` -> `{after}`"

    def known_name(self):
        """What names it in a list that outlives a shift of lines."""
        before, after = one_line(self.before), one_line(self.alternatives[0])
        return f"{self.file}: {self.source_line}: {self.kind}: `{before}` -> `{after}`"

    def is_dropped_return(self):
        return self.kind == "dropped statement" and self.before.startswith("return ")

    def applied(self, text, alternative):
        return text[:self.start] + alternative + text[self.start + len(self.before):]


def one_line(text):
    return re.sub(r"\s+", " ", text)


def is_order_free(first, second):
    """Says whether the order of two statements means nothing: they set different things, neither of
    which the other mentions, or one makes a variable that the other does without."""
    makings = [(MAKING.fullmatch(first), second), (MAKING.fullmatch(second), first)]
    if any(making and not mentions(other, making) for making, other in makings):
        return True
    settings = [(SETTING.fullmatch(first), second), (SETTING.fullmatch(second), first)]
    return all(setting and not mentions(other, setting) for setting, other in settings)


def mentions(statement, setting):
    """Says whether a statement names what another one sets, as a field or by its setter."""
    names = [name for name in setting.groups() if name]
    names += [variant for name in names
              for variant in ("set" + name, name[0].lower() + name[1:])]
    return not set(names).isdisjoint(re.findall(r"\w+", statement))


def constants_by_name(texts):
    """For each constant the next one of its family, in the order of their names."""
    words = {word for text in texts for word in re.findall(r"\b[A-Za-z]\w+", text)}
    following = {}
    for family in FAMILIES:
        members = sorted(word for word in words if family.fullmatch(word))
        for member, other in zip(members, members[1:] + members[:1]):
            if member != other:
                following[member] = [other]
    for first, second in PAIRS:
        following.setdefault(first, []).append(second)
        following.setdefault(second, []).append(first)
    return following


class Finder:
    """The changes of one file."""

    def __init__(self, file, text, constants):
        self.file = file
        self.source = Source(text)
        self.constants = constants
        self.changes = []

    def find(self):
        for i, token in enumerate(self.source.tokens):
            finder = getattr(self, "_" + token.kind)
            finder(i, token.text)
        return self.changes

    def _add(self, kind, first, last, *alternatives):
        self._replace(kind, self.source.tokens[first].start, self.source.between(first, last),
                      alternatives)

    def _replace(self, kind, start, before, alternatives):
        text = self.source.text
        line_start = text.rfind("\n", 0, start) + 1
        source_line = text[line_start:text.find("\n", start)].strip()
        self.changes.append(Change(self.file, start, before, tuple(alternatives), kind,
                                   text.count("\n", 0, start) + 1, start - line_start + 1,
                                   source_line))

    def _text(self, i, text):
        if self.source[i - 1] != "extern":
            self._add("text", i, i, text[:-1] + 'x"')

    def _character(self, i, text):
        self._add("constant", i, i, "'x'" if text != "'x'" else "'y'")

    def _number(self, i, text):
        digits = re.fullmatch(r"(0x[0-9A-Fa-f]+|[\d']+(?:\.\d+)?)(\w*)", text)
        number, suffix = digits.group(1).replace("'", ""), digits.group(2)
        value = float(number) if "." in number else int(number, 0)
        for other in [value + 1] + ([value - 1] if value else []):
            self._add("constant", i, i, f"{other}{suffix}")

    def _word(self, i, text):
        opposite = {"true": "false", "false": "true"}.get(text)
        if opposite:
            self._add("constant", i, i, opposite)
        for other in self.constants.get(text, []):
            self._add("constant", i, i, other)
        if text == "if" and self.source[i + 1] == "(":
            self._condition(i + 2, self.source.partner[i + 1] - 1)

    def _condition(self, first, last):
        """Negates a condition, unless another change does the same or it declares something."""
        words = {self.source[i] for i in range(first, last + 1)}
        has_one_operator = not words & LOGICAL and (words & COMPARISONS or
                                                    self.source[first] == "!")
        if not has_one_operator and "=" not in words:
            self._add("negation", first, last, f"!({self.source.between(first, last)})")

    def _sign(self, i, text):
        if text in OPERATORS and self.source.is_spaced(i):
            self._operator(i, text)
        elif text == "++":
            self._add("arithmetic", i, i, "--")
        elif text == "!":
            self._replace("negation", self.source.tokens[i].start, "!", [""])
        elif text == "?":
            self._ternary(i)
        elif text == ";":
            self._statement(i)
        elif text in CLOSING:
            self._bracket(i, text)

    def _operator(self, i, text):
        kind = ("logical operator" if text in LOGICAL
                else "comparison" if text in COMPARISONS else "arithmetic")
        for other in OPERATORS[text]:
            self._add(kind, i, i, other)

    def _ternary(self, i):
        parent, colon = self.source.parent[i], None
        for j in range(i + 1, len(self.source)):
            if self.source.parent[j] != parent and j != self.source.partner.get(parent):
                continue
            if self.source[j] == ":" and colon is None:
                colon = j
            elif self.source[j] in {";", ","} or j == self.source.partner.get(parent):
                first = self.source.between(i + 1, colon - 1)
                second = self.source.between(colon + 1, j - 1)
                self._add("order", i + 1, j - 1, f"{second} : {first}")
                return

    def _statement(self, i):
        source = self.source
        if source.parent[i] not in source.bodies:
            return
        start = source.statement_start(i)
        if start == i:
            return
        if self._is_needed(start, i):
            return
        self._add("dropped statement", start, i, "{}")
        if source[start - 1] != ";" or source.parent[start - 1] != source.parent[i]:
            return
        former = source.statement_start(start - 1)
        if (source[former - 1] in {"else", "do"} or self._follows_control(former)
                or self._is_needed(former, start - 1)):
            return
        first, second = source.between(former, start - 1), source.between(start, i)
        if not is_order_free(first, second):
            self._add("order", former, i, f"{second} {first}")

    def _is_needed(self, first, last):
        """Says whether nothing compiles without a statement: one that makes a variable from a
        value, which others read, or the last return of a function."""
        source = self.source
        if source[first] == "return" and last > first + 1 and source[last + 1] == "}":
            return not self._follows_control(source.parent[last])
        left = list(itertools.takewhile(lambda token: token.text != "=",
                                        source.tokens[first:last]))
        has_value = len(left) < last - first
        return has_value and (source[first] in {"const", "auto", "using"} or (
            len(left) > 1 and left[-1].kind == "word"
            and (left[-2].kind == "word" or left[-2].text in {"&", "*", ">"})))

    def _follows_control(self, i):
        before = self.source[i - 1] == ")" and self.source[self.source.partner[i - 1] - 1]
        return before in CONTROL

    def _bracket(self, i, text):
        source = self.source
        if i in source.bodies:
            self._early_return(i)
            return
        is_list = text == "{" or (text == "(" and self._is_call(i))
        if not is_list or not source.is_in_body(i):
            return
        if self._called(i) in SYMMETRIC:
            return
        items = source.items(i)
        for (first, last), (next_first, next_last) in zip(items, items[1:]):
            former, latter = source.between(first, last), source.between(next_first, next_last)
            if self._shape(first) == self._shape(next_first) and former != latter:
                self._add("order", first, next_last, f"{latter}, {former}")

    def _called(self, i):
        """The name of the function that a bracket calls, its template arguments aside."""
        name = i - 1
        if self.source[name] == ">":
            while self.source[name] != "<":
                name -= 1
            name -= 1
        return self.source[name]

    def _shape(self, first):
        """What kind of argument begins with a token; those of two kinds do not fit in each other's
        places."""
        token = self.source.tokens[first]
        shape = token.text if token.text in {"&", "*", "[", "{"} else token.kind
        return "word" if shape in {"text", "number", "sign"} else shape

    def _is_call(self, i):
        before = self.source.tokens[i - 1]
        return (before.kind == "word" and before.text not in CONTROL) or before.text == ">"

    def _early_return(self, i):
        """At the head of a function or lambda, not of a statement within one."""
        before = self.source[i - 1]
        if before in {"else", "do"} or self._follows_control(i):
            return
        if self.source.partner[i] == i + 1:
            return
        is_void = self.source[self._declaration_start(i)] == "void"
        alternatives = [" return;"] if is_void else [" return {};", " return;"]
        self._replace("early return", self.source.tokens[i].end, "", alternatives)

    def _declaration_start(self, i):
        while i > 0 and self.source[i - 1] not in {";", "{", "}", ":"}:
            i = self.source.partner[i - 1] if self.source[i - 1] in {")", "]"} else i - 1
        return i


def all_changes(folder, files):
    """The changes of `files`, paths within `folder`, in their order."""
    texts = {str(path): path.read_text(encoding="utf-8")
             for path in sorted(folder.glob("Sources/**/*.h"))}
    constants = constants_by_name(texts.values())
    changes = []
    for file in files:
        changes += Finder(file, (folder / file).read_text(encoding="utf-8"), constants).find()
    return changes
