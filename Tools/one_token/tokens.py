"""Cuts a C++ source into tokens and says how they nest. Made for clang-formatted sources: it relies
on spaces around binary operators and knows no macros."""

import dataclasses
import re

TOKEN = re.compile(
    r"""(?P<space>\s+|//[^\n]*|/\*.*?\*/|^\#[^\n]*)
      |(?P<text>R"\(.*?\)"|"(?:\\.|[^"\\\n])*")
      |(?P<character>'(?:\\.|[^'\\\n])+')
      |(?P<number>\d(?:[\w.]|'(?=\d))*)
      |(?P<word>[A-Za-z_]\w*)
      |(?P<sign><=>|->\*|\.\.\.|::|->|\+\+|--|<<|<=|>=|==|!=|&&|\|\||[-+*/%&|^]=|.)""",
    re.DOTALL | re.MULTILINE | re.VERBOSE)

CLOSING = {"(": ")", "[": "]", "{": "}"}
CONTROL = {"if", "for", "while", "switch", "catch", "constexpr"}
SCOPES = {"namespace", "class", "struct", "enum", "union", "extern"}


@dataclasses.dataclass(frozen=True)
class Token:
    text: str
    kind: str
    start: int

    @property
    def end(self):
        return self.start + len(self.text)


class Source:
    """The tokens of one file, their partners among the brackets, and what each brace encloses."""

    def __init__(self, text):
        self.text = text
        self.tokens = [Token(m.group(), m.lastgroup, m.start()) for m in TOKEN.finditer(text)
                       if m.lastgroup != "space"]
        self.partner = {}  # Of a bracket, by index, both ways.
        self.parent = []  # The index of the innermost open bracket around each token; or none.
        self._match_brackets()
        self.bodies = {i for i, token in enumerate(self.tokens)
                       if token.text == "{" and self._opens_body(i)}

    def __getitem__(self, index):
        """The text of a token; beyond the ends nothing."""
        return self.tokens[index].text if 0 <= index < len(self.tokens) else ""

    def __len__(self):
        return len(self.tokens)

    def between(self, first, last):
        """The source from one token to another, both included."""
        return self.text[self.tokens[first].start:self.tokens[last].end]

    def is_spaced(self, index):
        """Says whether the token stands free, as binary operators do."""
        token = self.tokens[index]
        return self.text[token.start - 1].isspace() and self.text[token.end].isspace()

    def is_in_body(self, index):
        """Says whether the token stands in a function, however deep."""
        parent = self.parent[index]
        return parent is not None and (parent in self.bodies or self.is_in_body(parent))

    def items(self, opening):
        """The pairs of first and last token of what commas separate within a bracket."""
        items, first, closing = [], opening + 1, self.partner[opening]
        for i in range(opening + 1, closing + 1):
            separates = self[i] == "," and self.parent[i] == opening
            if (separates or i == closing) and first < i:
                items.append((first, i - 1))
            if separates:
                first = i + 1
        return items

    def statement_start(self, end):
        """The index of the first token of the statement that ends with the semicolon `end`."""
        i = end
        while i > 0:
            before = self[i - 1]
            if before in (";", "{", "else", "do"):
                return i
            if before == "}" and not self._continues(i):
                return i
            if before in (")", "]", "}"):
                opening = self.partner[i - 1]
                if before == ")" and self[opening - 1] in CONTROL:
                    return i
                i = opening
            else:
                i -= 1
        return i

    def _continues(self, index):
        """Says whether a token goes on with an expression that a brace before it has closed."""
        return self[index] in {")", ",", ";", ".", "(", "[", "->", "]", "}", "==", "&&", "||"}

    def _match_brackets(self):
        open_brackets = []
        for i, token in enumerate(self.tokens):
            if token.kind == "sign" and token.text in CLOSING.values():
                opening = open_brackets.pop()
                self.partner[i], self.partner[opening] = opening, i
            self.parent.append(open_brackets[-1] if open_brackets else None)
            if token.kind == "sign" and token.text in CLOSING:
                open_brackets.append(i)

    def _opens_body(self, index):
        """Tells a function's, lambda's or statement's brace from a scope's and an initialiser's."""
        if self[index - 1] == ")" and self[self.partner[index - 1] - 1] == "requires":
            return False
        if self[index - 1] in {")", "]", "else", "do", "try", "const", "noexcept", "override"}:
            return True
        for i in range(index - 1, max(index - 12, -1), -1):  # A return type behind an arrow.
            if self[i] == "->":
                return self[i - 1] in {")", "mutable"}
            if self[i] in {";", "{", "}", "(", ","} or self[i] in SCOPES:
                return False
        return False
