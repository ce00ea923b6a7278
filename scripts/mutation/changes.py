"""The small changes that a source file allows: where each is, what it reads before and after."""

import collections
import dataclasses
import hashlib
import re

# What the compiler does not run: comments, preprocessor lines, text, and conditions that are only
# stated (a weaker assertion is no change of behaviour).
_COMMENT = re.compile(r"//[^\n]*|/\*.*?\*/", re.DOTALL)
_DIRECTIVE = re.compile(r"^[ \t]*#(?:[^\n]*\\\n)*[^\n]*", re.MULTILINE)
_TEXT = re.compile(r'"(?:\\.|[^"\\\n])*"|(?<!\w)\'(?:\\.|[^\'\\\n])\'')
_ASSERTION = re.compile(r"\b(?:static_assert|VORN_ASSERT)\s*(?=\()")

# Binary operators stand between blanks (clang-format sees to it), template brackets do not.
_BINARY = {
    "<": ("<=", ">="), "<=": ("<", ">"), ">": (">=", "<="), ">=": (">", "<"),
    "==": ("!=",), "!=": ("==",), "&&": ("||",), "||": ("&&",),
    "+": ("-",), "-": ("+",), "*": ("/",), "/": ("*",),
    "+=": ("-=",), "-=": ("+=",), "*=": ("/=",), "/=": ("*=",),
}
_KINDS = {
    "strictness": ("<", "<=", ">", ">="), "equality": ("==", "!="), "logic": ("&&", "||"),
    "arithmetic": ("+", "-", "*", "/"), "assignment": ("+=", "-=", "*=", "/="),
}
_BINARY_PATTERN = re.compile(
    r"(?<=[\w)\]}\"'] )(" + "|".join(re.escape(o) for o in sorted(_BINARY, key=len, reverse=True))
    + r")(?=\s)")
_COUNTING = re.compile(r"\+\+|--")
_MINUS = re.compile(r"(?:(?<=[(\[{!])|(?<=[,=?:<>*/+&|-] )|(?<=return ))-(?=[\w(])")
_NOT = re.compile(r"!(?=[\w(*:])")
_TRUTH = re.compile(r"\b(?:true|false)\b")
_EXTREME = re.compile(r"\bstd::(min|max)\b(?=\()")
_NUMBER = re.compile(
    r"(?<![\w.])(?:0x[0-9a-fA-F']+|\d[\d']*(?:\.\d*)?(?:e[-+]?\d+)?)(?=[uUlLfF]*(?![\w.]))")
_LINE_STATEMENT = re.compile(
    r"(?:\+\+|--)?\(?\*?[\w:.\[\]()*+&<>-]*\w[\w:.\[\]()*+&<>-]*(?: [-+*/|&]?= |\(|\+\+;|--;)"
    r"|(?:break|continue);|if \(")
_NO_STATEMENT = re.compile(r"(?:return|using|for|while|switch|do|else|constexpr|static|case)\b")
_APPEND = re.compile(r"[\w.>\[\]()-]*(?:\.|->)?(?:push_back|emplace_back|insert|Append\w*|Add\w*|"
                     r"Push\w*)\(")


@dataclasses.dataclass(frozen=True)
class Change:
    """One change: text[start:end] of the file becomes new."""

    file: str
    kind: str
    start: int
    end: int
    new: str
    line: int
    before: str
    after: str
    occurrence: int

    @property
    def key(self):
        """What the change is known by: its text, not its line number."""
        text = "\0".join((self.file, self.before, self.after, str(self.occurrence)))
        return hashlib.sha1(text.encode()).hexdigest()[:12]

    def apply(self, text):
        return text[:self.start] + self.new + text[self.end:]


def _blank(match):
    return re.sub(r"[^\n]", " ", match.group())


def _end_of_brackets(code, start):
    """The position after the bracket that closes the one at start."""
    depth = 0
    for position in range(start, len(code)):
        if code[position] in "([{":
            depth += 1
        elif code[position] in ")]}":
            depth -= 1
            if depth == 0:
                return position + 1
    return len(code)


def code_of(text):
    """The text with everything blank that is not run; every position stays."""
    strings_kept = re.compile(_TEXT.pattern + "|" + _COMMENT.pattern, re.DOTALL)
    code = strings_kept.sub(_blank, text)
    code = _DIRECTIVE.sub(_blank, code)
    for match in list(_ASSERTION.finditer(code)):
        end = _end_of_brackets(code, match.end())
        code = code[:match.start()] + re.sub(r"[^\n]", " ", code[match.start():end]) + code[end:]
    return code


def _larger(number):
    """Another number: 0 becomes 1, an integer one more, any other its double."""
    plain = number.replace("'", "")
    if plain.startswith("0x"):
        return hex(int(plain, 16) + 1)
    if re.fullmatch(r"\d+", plain):
        return str(int(plain) + 1)
    value = float(plain)
    return "1.0" if value == 0.0 else repr(2.0 * value)


def _token_changes(code):
    """(kind, start, end, new) of each change of one token."""
    for match in _BINARY_PATTERN.finditer(code):
        operator = match.group(1)
        kind = next(name for name, operators in _KINDS.items() if operator in operators)
        for new in _BINARY[operator]:
            is_negated = kind == "strictness" and new[0] != operator[0]
            yield "negation" if is_negated else kind, match.start(1), match.end(1), new
    for match in _COUNTING.finditer(code):
        yield "counting", match.start(), match.end(), "--" if match.group() == "++" else "++"
    for match in _MINUS.finditer(code):
        yield "sign", match.start(), match.end(), ""
    for match in _NOT.finditer(code):
        yield "not", match.start(), match.end(), ""
    for match in _TRUTH.finditer(code):
        other = "false" if match.group() == "true" else "true"
        yield "truth", match.start(), match.end(), other
    for match in _EXTREME.finditer(code):
        yield "extreme", match.start(1), match.end(1), "max" if match.group(1) == "min" else "min"
    for match in _NUMBER.finditer(code):
        yield "literal", match.start(), match.end(), _larger(match.group())


def _statement_end(code, start):
    """The position after the semicolon of the statement, None where a block comes first."""
    position = start
    while position < len(code):
        if code[position] in "([":
            position = _end_of_brackets(code, position)
        elif code[position] == ";":
            return position + 1
        elif code[position] in "{}":
            return None
        else:
            position += 1
    return None


def _statements(code):
    """(start, end) of statements that stand on lines of their own and declare nothing."""
    for match in re.finditer(r"^[ \t]+(?=\S)", code, re.MULTILINE):
        start = match.end()
        before = code[:start].rstrip()[-1:]
        if before not in ";{})" or not _LINE_STATEMENT.match(code, start):
            continue
        if _NO_STATEMENT.match(code, start):
            continue
        end = _statement_end(code, start)
        if end is None or re.match(r"\s*else\b", code[end:]):
            continue
        yield start, end


def _statement_changes(code, text):
    """A statement that is missing, or two appends in the other order."""
    previous = None
    for start, end in _statements(code):
        lines = text.count("\n", start, end)
        yield "dropped statement", start, end, ";" + "\n" * lines
        if previous and code[previous[1]:start].strip() == "":
            first, second = text[previous[0]:previous[1]], text[start:end]
            if _APPEND.match(first) and _APPEND.match(second) and first != second:
                between = text[previous[1]:start]
                yield "order of appends", previous[0], end, second + between + first
        previous = (start, end)


def _squeezed(text):
    return " ".join(text.split())


def changes_of(file, text):
    """Every change of a file, in the order of its text."""
    code = code_of(text)
    seen = collections.Counter()
    found = list(_token_changes(code)) + list(_statement_changes(code, text))
    for kind, start, end, new in sorted(found):
        first = text.rfind("\n", 0, start) + 1
        last = text.find("\n", end)
        last = len(text) if last < 0 else last
        before = _squeezed(text[first:last])
        after = _squeezed(text[first:start] + new + text[end:last])
        seen[before, after] += 1
        yield Change(file, kind, start, end, new, text.count("\n", 0, start) + 1, before, after,
                     seen[before, after])


def chosen_order(changes_by_file, seed):
    """All changes in the order of trial: spread over the files (the share of a file grows with
    the root of what it allows) and over the kinds in each. The place of a change depends on its
    own file only."""
    ranked = []
    for file, changes in changes_by_file.items():
        def chance(change):
            return hashlib.sha1(f"{seed}:{change.key}".encode()).hexdigest()
        by_kind = collections.defaultdict(list)
        for change in sorted(changes, key=chance):
            by_kind[change.kind].append(change)
        rounds = sorted((rank, chance(change), change) for kind in by_kind.values()
                        for rank, change in enumerate(kind))
        share = max(len(changes), 1) ** 0.5
        ranked += [((place + 0.5) / share, file, place, change)
                   for place, (_, _, change) in enumerate(rounds)]
    return [change for *_, change in sorted(ranked, key=lambda entry: entry[:3])]
