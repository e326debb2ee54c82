"""Finds the places of a C++ source that script/mutate changes, one at a time.

A lexer is all it takes: what a change makes of the types is the compiler's to
judge. The sources are formatted, so an operator of two operands stands between
blanks, and "<" of a template, "&" of a reference and "*" of a pointer do not.
"""

import re
from dataclasses import dataclass

TOKEN = re.compile(
    r"""(?P<comment>//[^\n]*|/\*.*?\*/)
      | (?P<directive>^[ \t]*\#(?:\\\n|[^\n])*)
      | (?P<string>(?:u8|[uUL])?R"(?P<mark>[^(\s]*)\(.*?\)(?P=mark)"
                  |(?:u8|[uUL])?"(?:\\.|[^"\\\n])*"
                  |(?:u8|[uUL])?'(?:\\.|[^'\\\n])*')
      | (?P<number>\.?[0-9](?:[eEpP][+-]|[0-9A-Za-z_.']|)*)
      | (?P<word>[A-Za-z_]\w*)
      | (?P<operator><=>|<<=|>>=|\.\.\.|->\*|->|::|\+\+|--|&&|\|\||
                     [-+*/%&|^<>=!]=|<<|>>|[^\s\w])""",
    re.VERBOSE | re.MULTILINE | re.DOTALL,
)

INTEGER = re.compile(r"(0[xX][0-9a-fA-F']+|0[bB][01']+|[0-9']+)([uUlLzZ]*)")

# Operator between blanks -> replacements.
BINARY = {
    "relational": {
        "<": ["<=", ">="], "<=": ["<", ">"], ">": [">=", "<="],
        ">=": [">", "<"], "==": ["!="], "!=": ["=="],
    },
    "arithmetic": {
        "+": ["-"], "-": ["+"], "*": ["/"], "/": ["*"], "%": ["*"],
        "+=": ["-="], "-=": ["+="], "*=": ["/="], "/=": ["*="], "%=": ["*="],
    },
    "logical": {"&&": ["||"], "||": ["&&"]},
    "bitwise": {
        "&": ["|"], "|": ["&"], "^": ["&"], "<<": [">>"], ">>": ["<<"],
        "&=": ["|="], "|=": ["&="], "^=": ["&="], "<<=": [">>="],
        ">>=": ["<<="],
    },
}
STEPS = {"++": "--", "--": "++"}
ASSIGNMENTS = {"=", "+=", "-=", "*=", "/=", "%=", "&=", "|=", "^=", "<<=", ">>="}
RELATIONS = set(BINARY["relational"])
OPEN, CLOSE = {"(": ")", "[": "]", "{": "}"}, {")": "(", "]": "[", "}": "{"}

# Words at the start of lines without a removable statement.
NO_STATEMENT = set(
    """alignas auto bool break case catch char class const consteval constexpr
    continue default delete do double else enum explicit extern float for friend
    goto if inline int long namespace operator private protected public return
    short signed static static_assert struct switch template thread_local throw
    try typedef typename union unsigned using virtual void volatile while
    """.split()
)


@dataclass(frozen=True)
class Token:
    kind: str
    text: str
    start: int
    end: int


@dataclass(frozen=True)
class Mutant:
    """Source text [start, end) replaced by other text."""

    path: str  # from the root of the tree
    source: str
    start: int
    end: int
    text: str

    @property
    def line(self):
        return self.source.count("\n", 0, self.start) + 1

    @property
    def change(self):
        """The line with the change in it: "if (a [< -> <=] b)"."""
        first = self.source.rfind("\n", 0, self.start) + 1
        last = self.source.find("\n", self.end)
        last = len(self.source) if last < 0 else last
        line = (
            f"{self.source[first:self.start]}[{self.source[self.start:self.end]}"
            f" -> {self.text}]{self.source[self.end:last]}"
        )
        return " ".join(line.split())

    def mutated(self):
        # The number of lines stays, because checks report line numbers.
        lines = self.source.count("\n", self.start, self.end) - self.text.count("\n")
        return (
            self.source[: self.start] + self.text + "\n" * lines
            + self.source[self.end :]
        )


def lex(source):
    """The tokens that may change; directives, comments and lines that only
    declare (template, using, static_assert) have none."""
    tokens = []
    skip_to = None  # the token that ends the declaration
    for match in TOKEN.finditer(source):
        kind = match.lastgroup if match.lastgroup != "mark" else "string"
        token = Token(kind, match.group(), match.start(), match.end())
        if kind in ("comment", "directive"):
            continue
        if skip_to == "\n" and token.start > line_end:
            skip_to = None
        if skip_to is None and token.text in ("static_assert", "using", "typedef"):
            skip_to = ";"
        elif skip_to is None and token.text == "template":
            skip_to = "\n"
            line_end = source.find("\n", token.end)
        if skip_to is None:
            tokens.append(token)
        elif skip_to == token.text:
            tokens.append(token)  # its ";" still ends a statement
            skip_to = None
    return tokens


class Places:
    """The mutants of one source."""

    def __init__(self, path, source):
        self.path = path
        self.source = source
        self.tokens = lex(source)
        self.partner = {}  # index of a bracket -> index of its other half
        self.inside = []  # per token the index of the bracket around it, or -1
        stack = []
        for i, token in enumerate(self.tokens):
            if token.text in CLOSE and stack:
                self.partner[i] = stack.pop()
                self.partner[self.partner[i]] = i
            self.inside.append(stack[-1] if stack else -1)
            if token.text in OPEN:
                stack.append(i)

    def all(self):
        found = {}  # each change once, whoever found it
        for i in range(len(self.tokens)):
            if i > 0 and self.text(i - 1) == "operator":
                continue
            for start, end, text in self.at(i):
                found.setdefault((start, end, text), None)
        return [Mutant(self.path, self.source, *key) for key in sorted(found)]

    def text(self, i):
        return self.tokens[i].text if 0 <= i < len(self.tokens) else ""

    def at(self, i):
        token = self.tokens[i]
        for text in self.replacements(i):
            yield token.start, token.end, text
        for first, last in self.conditions(i):
            if not self.is_negated_otherwise(first, last):
                yield *self.span(first, last), f"!({self.between(first, last)})"
        yield from self.returns(i)
        if self.begins_statement(i):
            yield from self.deletion(i)

    def span(self, first, last):
        return self.tokens[first].start, self.tokens[last].end

    def between(self, first, last):
        start, end = self.span(first, last)
        return self.source[start:end]

    def replacements(self, i):
        """What may take the place of token i alone."""
        token = self.tokens[i]
        if token.kind == "number":
            yield from self.numbers(i)
        elif token.text in ("true", "false"):
            yield "false" if token.text == "true" else "true"
        elif token.text in STEPS:
            yield STEPS[token.text]
        elif token.text == "!":
            yield ""
        elif self.stands_between_blanks(token):
            for table in BINARY.values():
                yield from table.get(token.text, [])

    def stands_between_blanks(self, token):
        around = self.source[token.start - 1 : token.start + 1], self.source[
            token.end : token.end + 1
        ]
        return around[0][:1].isspace() and around[1].isspace()

    def numbers(self, i):
        match = INTEGER.fullmatch(self.text(i))
        if not match:
            return
        if self.text(i - 1) == "=" and self.text(i - 2) in (")", "const", "override"):
            return  # a pure virtual function
        digits, suffix = match.groups()
        digits = digits.replace("'", "")
        octal = re.fullmatch(r"0[0-7]+", digits)
        value = int(digits, 8 if octal else 0)
        yield f"{value + 1}{suffix}"
        if value > 0:
            yield f"{value - 1}{suffix}"

    def conditions(self, i):
        """The condition that begins with keyword or ends before "?" i."""
        text = self.text(i)
        if text in ("if", "while", "for"):
            opening = i + 1 + (self.text(i + 1) == "constexpr")
            if self.text(opening) != "(" or opening not in self.partner:
                return
            closing = self.partner[opening]
            parts = [opening]
            parts += [
                j for j in range(opening, closing)
                if self.text(j) == ";" and self.inside[j] == opening
            ]
            parts.append(closing)
            if text == "for" and len(parts) != 4:
                return
            first, last = (
                (parts[1] + 1, parts[2] - 1) if text == "for"
                else (parts[-2] + 1, closing - 1)
            )
            declares = any(
                self.text(j) == "=" and self.inside[j] == opening
                for j in range(first, last + 1)
            )
            if first <= last and not declares:
                yield first, last
        elif text == "?":
            first = i
            while self.inside[first - 1] == self.inside[i] or (
                first - 1 in self.partner and self.partner[first - 1] < first - 1
            ):
                first = self.partner[first - 1] if self.text(first - 1) in CLOSE else first - 1
                if self.text(first) in ASSIGNMENTS | {"return", ",", ";", "?", ":", "}"}:
                    first += 1
                    break
            if first < i:
                yield first, i - 1

    def is_negated_otherwise(self, first, last):
        """True if changing its only relation, or dropping its only "!", makes
        the same mutant."""
        if any(self.text(j) in ("&&", "||", "?") for j in range(first, last + 1)):
            return False
        outer = [j for j in range(first, last + 1) if self.inside[j] == self.inside[first]]
        relations = [
            j for j in outer
            if self.text(j) in RELATIONS and self.stands_between_blanks(self.tokens[j])
        ]
        return len(relations) == 1 or self.text(first) == "!"

    def returns(self, i):
        if self.text(i) != "return":
            return
        last = self.end_of_statement(i)
        if last is None or last == i + 1:
            return
        value = self.between(i + 1, last - 1)
        if re.fullmatch(r"true|false|nullptr|\{\}|-?[0-9]+", value):
            return
        for constant in ("{}", "true"):
            yield *self.span(i + 1, last - 1), constant

    def end_of_statement(self, i):
        """The index of the ";" that ends the statement, if no block begins."""
        for j in range(i, len(self.tokens)):
            if self.inside[j] != self.inside[i]:
                continue
            if self.text(j) == ";":
                return j
            if self.text(j) in ("{", "}") and self.text(i) != "return":
                return None
        return None

    def begins_statement(self, i):
        around = self.inside[i]
        if around < 0 or self.text(around) != "{":
            return False
        before = self.text(i - 1)
        if before in (";", "{", "}", "else", "do"):
            return True
        if before == ")":
            keyword = self.partner.get(i - 1, 0) - 1
            return self.text(keyword) in ("if", "for", "while", "constexpr")
        return before == ":" and self.text(i - 3) in ("case", "default", "::")

    def deletion(self, i):
        """The statement that is only a call or an assignment, taken out."""
        if self.tokens[i].kind != "word" and self.text(i) not in ("*", "::"):
            return
        if self.text(i) in NO_STATEMENT or self.is_declaration(i):
            return
        last = self.end_of_statement(i)
        if last is None:
            return
        assigns = any(
            self.text(j) in ASSIGNMENTS and self.inside[j] == self.inside[i]
            for j in range(i, last)
        )
        if assigns or self.text(last - 1) == ")":
            yield *self.span(i, last), ";"

    def is_declaration(self, i):
        """A type, qualified or with arguments, and a name after it."""
        j = i
        while self.text(j + 1) == "::":
            j += 2
        if self.text(j + 1) == "<" and not self.stands_between_blanks(self.tokens[j + 1]):
            depth = 0
            for j in range(j + 1, len(self.tokens)):
                depth += {"<": 1, ">": -1, ">>": -2}.get(self.text(j), 0)
                if depth <= 0:
                    break
        while self.text(j + 1) in ("*", "&", "&&"):
            j += 1
        after = self.tokens[j + 1] if j + 1 < len(self.tokens) else None
        return self.tokens[i].kind == "word" and after is not None and after.kind == "word"


def mutants_of(path, source):
    return Places(path, source).all()
