"""Small changes to C++ source, one at a time."""
import re
from dataclasses import dataclass


@dataclass(frozen=True)
class Mutant:
    path: str
    line: int  # from 1
    operator: str
    before: str
    after: str

    def key(self):
        """Identifies an accepted survivor by its text and change, not by its line number."""
        return (self.path, self.before.strip(), self.after.strip())


def negated_conditions(code):
    match = re.match(r"^(\s*(?:\} else )?if \()(.*)(\) \{)$", code)
    if match:
        yield f"{match[1]}!({match[2]}){match[3]}"
    for found in re.finditer(r"\breturn ([^;]*(?:==|!=|&&|\|\||<|>)[^;]*);", code):
        yield f"{code[:found.start()]}return !({found[1]});{code[found.end():]}"


def replaced(pattern, replacement):
    def mutate(code):
        for found in re.finditer(pattern, code):
            text = replacement(found) if callable(replacement) else found.expand(replacement)
            yield code[: found.start()] + text + code[found.end():]

    return mutate


def dropped_statements(code):
    statement = code.strip()
    is_call = re.match(r"^[\w:.\->\[\]\*\(\)]+\(.*\);$", statement)
    is_assignment = re.match(r"^\*?[\w.\->]+(\[[^\]]*\])? [-+|]?= .*;$", statement)
    is_count = re.match(r"^(\+\+|--)[\w.\->]+;$", statement)
    if (is_call or is_assignment or is_count) and not statement.startswith(("return", "throw")):
        yield code[: len(code) - len(code.lstrip())] + ";"
    if statement == "continue;" or re.match(r"^return;$", statement):
        yield code.replace(statement, ";")


def swapped_arguments(code):
    for found in re.finditer(r"\b(\w+)\(([^(),]+), ([^(),]+)([,)])", code):
        yield f"{code[:found.start()]}{found[1]}({found[3]}, {found[2]}{found[4]}{code[found.end():]}"


def changed_texts(code):
    for found in re.finditer(r'"((?:[^"\\]|\\.)+)"', code):
        text = found[1]
        yield f'{code[:found.start()]}"{text[1:] if text[0] != chr(92) else "x" + text}"{code[found.end():]}'
        yield f'{code[:found.start()]}"{text} "{code[found.end():]}'


STATUS = "kNotOffered kInitializationFailed kOutOfMemory kParseError kFileError kNotFound kNotSupported kSchemaMismatch kMissingParameter"


def next_status(found):
    names = STATUS.split()
    return names[(names.index(found[0]) + 1) % len(names)]


OPERATORS = {
    "negated condition": negated_conditions,
    "== to !=": replaced(r"(?<![=!<>])==(?!=)", "!="),
    "!= to ==": replaced(r"!=", "=="),
    "< to <=": replaced(r" < ", " <= "),
    "> to >=": replaced(r" > ", " >= "),
    "&& to ||": replaced(r"&&(?!\w)", "||"),
    "|| to &&": replaced(r"\|\|", "&&"),
    "not dropped": replaced(r"!(?=[\w(])", ""),
    "true to false": replaced(r"\btrue\b", "false"),
    "false to true": replaced(r"\bfalse\b", "true"),
    "number plus one": replaced(r"(?<![\w.\"])(\d+)(?![\w.\"])", lambda found: str(int(found[1]) + 1)),
    "status": replaced(r"\b(?:" + STATUS.replace(" ", "|") + r")\b", next_status),
    "INCLUDE and EXCLUDE": replaced(r"\b(INCLUDE|EXCLUDE)\b(?!\")", lambda f: "EXCLUDE" if f[1] == "INCLUDE" else "INCLUDE"),
    "dropped statement": dropped_statements,
    "swapped arguments": swapped_arguments,
    "text": changed_texts,
}
# In headers only values are changed: a changed declaration would not compile.
HEADER_OPERATORS = ("number plus one", "status", "true to false", "false to true", "text")


def is_code(line):
    stripped = line.strip()
    ignored = ("//", "#", "/*", "*", "using ", "namespace ", "class ", "template", "friend ", "static_assert")
    is_end = stripped.startswith("}") and not stripped.startswith("} else")
    return bool(stripped) and not is_end and not stripped.startswith(ignored)


def mutants_of(path, text):
    for number, line in enumerate(text.split("\n"), 1):
        if not is_code(line):
            continue
        code, comment, rest = line.partition("  //")
        seen = {code}
        for name in HEADER_OPERATORS if path.endswith(".h") else OPERATORS:
            operator = OPERATORS[name]
            for after in operator(code):
                if after not in seen:
                    seen.add(after)
                    yield Mutant(path, number, name, line, after + comment + rest)
