"""Finds what can be mutated in a C++ source: every mutant replaces a piece of text by another.

It asks the compiler's own parser, so that a mutant is an expression with its operands and never a line of a comment.
"""
import dataclasses

from clang.cindex import Config, CursorKind, Index, TranslationUnit

Config.set_library_file("/usr/lib/x86_64-linux-gnu/libclang-19.so.19")

OPERATORS = {
    "<": ["<=", ">"],
    "<=": ["<", ">"],
    ">": [">=", "<"],
    ">=": [">", "<"],
    "==": ["!="],
    "!=": ["=="],
    "+": ["-"],
    "-": ["+"],
    "*": ["/"],
    "/": ["*"],
    "%": ["/"],
    "<<": [">>"],
    ">>": ["<<"],
    "&": ["|"],
    "|": ["&"],
    "^": ["|"],
    "&&": ["||"],
    "||": ["&&"],
    "+=": ["-="],
    "-=": ["+="],
    "<<=": [">>="],
    ">>=": ["<<="],
    "|=": ["&="],
    "&=": ["|="],
    "^=": ["|="],
}
# The compiler evaluates these, so they cannot be switched at run time.
SETTLED = {
    CursorKind.STATIC_ASSERT,
    CursorKind.ENUM_CONSTANT_DECL,
    CursorKind.TEMPLATE_NON_TYPE_PARAMETER,
    CursorKind.TEMPLATE_TYPE_PARAMETER,
    CursorKind.TYPE_ALIAS_DECL,
    CursorKind.CONCEPT_DECL,
    CursorKind.REQUIRES_EXPR,
}


@dataclasses.dataclass(frozen=True)
class Mutant:
    path: str
    begin: int  # of the expression that is replaced, in bytes
    end: int
    text: str  # what stands in its place
    line: int
    words: str  # what changes, for people
    turned: bool = False  # a condition that means its opposite

    def at(self, path):
        """The same mutant in a file of another name."""
        return dataclasses.replace(self, path=path)


class Finder:
    def __init__(self, path, source):
        self.path = path
        self.source = source
        self.mutants = []
        self.starts = [0]
        for index, byte in enumerate(source):
            if byte == 10:
                self.starts.append(index + 1)

    def text(self, begin, end):
        return self.source[begin:end].decode()

    def add(self, cursor, text, words, turned=False):
        begin, end = cursor.extent.start.offset, cursor.extent.end.offset
        self.mutants.append(Mutant(self.path, begin, end, text, cursor.extent.start.line, words, turned))

    def visit(self, cursor):
        if cursor.kind in SETTLED or self.is_constant(cursor) or self.is_settled_function(cursor):
            return
        children = list(cursor.get_children())
        if cursor.extent.start.offset < cursor.extent.end.offset:
            self.mutate(cursor, children)
        for index, child in enumerate(children):
            if cursor.kind == CursorKind.CASE_STMT and index == 0:
                continue
            if cursor.kind == CursorKind.IF_STMT and index == 0 and self.is_constexpr_if(cursor):
                continue
            # Excludes a template's arguments, a field's width and an array's size, which precede the initialiser.
            if cursor.kind in (CursorKind.VAR_DECL, CursorKind.FIELD_DECL) and self.before_name(cursor, child):
                continue
            if self.in_angle_brackets(child):
                continue
            self.visit(child)

    @staticmethod
    def before_name(cursor, child):
        return child.extent.end.offset <= cursor.location.offset

    def in_angle_brackets(self, child):
        """A template's argument written as an expression."""
        if child.kind not in (CursorKind.INTEGER_LITERAL, CursorKind.CXX_BOOL_LITERAL_EXPR, CursorKind.BINARY_OPERATOR):
            return False
        before = self.source[: child.extent.start.offset].rstrip()
        after = self.source[child.extent.end.offset :].lstrip()
        return after[:1] == b">" and before[-1:] in (b"<", b",") and not after.startswith((b">>", b">="))

    def is_constant(self, cursor):
        if cursor.kind != CursorKind.VAR_DECL:
            return False
        return "constexpr" in self.text(cursor.extent.start.offset, cursor.location.offset)

    def is_settled_function(self, cursor):
        if cursor.kind not in (CursorKind.FUNCTION_DECL, CursorKind.CXX_METHOD, CursorKind.FUNCTION_TEMPLATE):
            return False
        return "consteval" in self.text(cursor.extent.start.offset, cursor.location.offset)

    def is_constexpr_if(self, cursor):
        return self.text(cursor.extent.start.offset, cursor.extent.end.offset).startswith("if constexpr")

    def mutate(self, cursor, children):
        begin, end = cursor.extent.start.offset, cursor.extent.end.offset
        text = self.text(begin, end)
        if cursor.kind in (CursorKind.BINARY_OPERATOR, CursorKind.COMPOUND_ASSIGNMENT_OPERATOR) and len(children) == 2:
            left, right = children
            between = self.text(left.extent.end.offset, right.extent.start.offset)
            operator = between.strip()
            for other in OPERATORS.get(operator, []):
                head = self.text(begin, left.extent.end.offset)
                tail = self.text(right.extent.start.offset, end)
                self.add(cursor, f"{head} {other} {tail}", f"{operator} becomes {other}: {text}")
        elif cursor.kind == CursorKind.UNARY_OPERATOR and len(children) == 1 and text.startswith("!"):
            self.add(cursor, f"bool({text[1:]})", f"! goes: {text}", turned=True)
        elif cursor.kind == CursorKind.UNARY_OPERATOR and len(children) == 1 and text.startswith("~"):
            self.add(cursor, text[1:], f"~ goes: {text}")
        elif cursor.kind == CursorKind.INTEGER_LITERAL:
            self.add(cursor, f"({text} + 1)", f"{text} becomes one more")
        elif cursor.kind == CursorKind.FLOATING_LITERAL:
            self.add(cursor, f"({text} + 1)", f"{text} becomes one more")
        elif cursor.kind == CursorKind.CXX_BOOL_LITERAL_EXPR and text in ("true", "false"):
            other = "false" if text == "true" else "true"
            self.add(cursor, other, f"{text} becomes {other}")
        if cursor.kind in (CursorKind.IF_STMT, CursorKind.WHILE_STMT) and not self.is_constexpr_if(cursor):
            self.negate(children[0])
        elif cursor.kind == CursorKind.CONDITIONAL_OPERATOR and len(children) == 3:
            self.negate(children[0])

    def negate(self, condition):
        """A condition that is not a comparison; comparisons have mutants of their own."""
        if not condition.kind.is_expression() or condition.kind == CursorKind.BINARY_OPERATOR:
            return
        text = self.text(condition.extent.start.offset, condition.extent.end.offset)
        if text.startswith("!"):
            return
        self.add(condition, f"!({text})", f"condition turned: {text}", turned=True)


def find_mutants(path, source, arguments):
    """All mutants of the file `path` with the bytes `source`, in the order of the text."""
    index = Index.create()
    unit = index.parse(path, args=arguments, options=TranslationUnit.PARSE_DETAILED_PROCESSING_RECORD)
    errors = [str(problem) for problem in unit.diagnostics if problem.severity >= 3]
    if errors:
        raise RuntimeError(f"{path}: {errors[0]}")
    macros = {
        (cursor.extent.start.offset, cursor.extent.end.offset)
        for cursor in unit.cursor.get_children()
        if cursor.kind == CursorKind.MACRO_INSTANTIATION
        and cursor.location.file is not None
        and cursor.location.file.name == path
    }
    finder = Finder(path, source)
    for cursor in unit.cursor.get_children():
        if cursor.location.file is not None and cursor.location.file.name == path:
            finder.visit(cursor)
    found = {}
    for mutant in finder.mutants:
        if any(begin < mutant.end and mutant.begin < end for begin, end in macros):
            continue
        found.setdefault((mutant.begin, mutant.end, mutant.text), mutant)
    return sorted(found.values(), key=lambda mutant: (mutant.begin, -mutant.end, mutant.text))
