"""The mutants of single expressions and statements."""
import re

from clang.cindex import CursorKind as Kind
from clang.cindex import TypeKind

from source import end_of, place_of, start_of

COMPARISONS = {"==": "!=", "!=": "==", "<": ">=", ">=": "<", ">": "<=", "<=": ">"}
BOUNDARIES = {"<": "<=", "<=": "<", ">": ">=", ">=": ">"}
CONNECTIVES = ("&&", "||")
NEGATION, REMOVED, SWAPPED = "negation", "removed statement", "swapped rows"
LITERAL = re.compile(r"(0[xX][0-9a-fA-F]+|[0-9]+)([uUlLzZ]*)")
# The declaration of an object, with what it is made of.
GUARD = re.compile(r"(?:const\s+)?(?P<type>[\w:]+(?:<[^;(){}]*>)?)\s+(?P<name>\w+)\s*"
                   r"(?:\((?P<values>.*)\)|\{(?P<braced>.*)\})?;", re.S)

FUNCTIONS = (Kind.FUNCTION_DECL, Kind.FUNCTION_TEMPLATE, Kind.CXX_METHOD, Kind.CONSTRUCTOR, Kind.DESTRUCTOR,
             Kind.CONVERSION_FUNCTION)
LOOPS = (Kind.WHILE_STMT, Kind.DO_STMT, Kind.FOR_STMT, Kind.CXX_FOR_RANGE_STMT)
HOLDERS = (Kind.COMPOUND_STMT, Kind.CASE_STMT, Kind.DEFAULT_STMT, Kind.IF_STMT, *LOOPS)
JUMPS = (Kind.RETURN_STMT, Kind.BREAK_STMT, Kind.CONTINUE_STMT)
ARRAYS = (TypeKind.CONSTANTARRAY, TypeKind.INCOMPLETEARRAY, TypeKind.DEPENDENTSIZEDARRAY)


def mutate_operator(source, operands, function):
    operator, start = source.operator_of(operands)
    for kind, table in (("comparison", COMPARISONS), ("boundary", BOUNDARIES)):
        if operator in table:
            source.add(function, kind, start, start + len(operator), table[operator],
                       (start_of(operands[0]), end_of(operands[-1])))
    if operator in CONNECTIVES:
        for operand in (operands[0], operands[-1]):
            negate(source, operand, function)


def negate(source, node, function):
    """Negates a condition, or a part of one, that no other mutant turns round."""
    while node.kind in (Kind.UNEXPOSED_EXPR, Kind.PAREN_EXPR) and len(list(node.get_children())) == 1:
        node = next(node.get_children())
    text = source.text_of(node)
    if not text or text.startswith("!") or text in ("true", "false"):
        return
    if text.endswith(tuple(COMPARISONS)):  # where clang's node of a comparison ends that it makes of <=>
        return
    if node.kind in (Kind.BINARY_OPERATOR, Kind.CALL_EXPR):
        operator, _ = source.operator_of(list(node.get_children()))
        if operator in COMPARISONS or operator in CONNECTIVES:
            return
    source.add(function, NEGATION, start_of(node), end_of(node), f"!({text})", place_of(node))


def drop_negation(source, node, function):
    if re.match(r"!(?!=)", source.text_of(node)):  # clang makes a != b of a == b where it has to
        source.add(function, NEGATION, start_of(node), start_of(node) + 1, "", place_of(node))


def mutate_constant(source, node, function):
    old = source.text_of(node)
    literal = LITERAL.fullmatch(old)
    if old in ("true", "false"):
        new = "false" if old == "true" else "true"
    elif literal:
        digits, suffix = literal.groups()
        base = 16 if digits[:2] in ("0x", "0X") else 8 if digits[0] == "0" and digits != "0" else 10
        value = int(digits, base)
        value = 0 if value == 1 else value + 1
        new = {16: f"0x{value:X}", 8: f"0{value:o}", 10: str(value)}[base] + suffix
    else:
        return
    source.add(function, "constant", start_of(node), end_of(node), new, place_of(node))


def swap_rows(source, node, rows, function, holder):
    """Swaps neighbours in an array's list, or in any list of lists; in an array's, a process may have them either way."""
    is_array = holder.kind == Kind.VAR_DECL and holder.type.kind in ARRAYS
    if not source.text_of(node).startswith("{"):
        return
    if not is_array and not all(source.text_of(row).startswith("{") for row in rows):
        return
    row_type = row_type_of(source, holder) if is_array else ""
    for one, other in zip(rows, rows[1:]):
        between = source.text[end_of(one):start_of(other)]
        if "," in between and source.holds(one) and source.holds(other):
            source.add(function, SWAPPED, start_of(one), end_of(other),
                       source.text_of(other) + between + source.text_of(one),
                       *((place_of(one), place_of(other)) if row_type else ()), type=row_type)


def row_type_of(source, table):
    """As the table's declaration has it."""
    words = source.text[start_of(table):table.location.offset]
    return " ".join(re.sub(r"\b(static|inline|constexpr|constinit|extern)\b", "", words).split())


def negate_condition(source, node, children, function):
    """Negates the condition of a statement or of a conditional expression, where it is an expression."""
    if node.kind == Kind.CONDITIONAL_OPERATOR:
        negate(source, children[0], function)
        return
    for child in children:
        before = source.text[start_of(node):start_of(child)].rstrip()[-1:]
        after = source.text[end_of(child):].lstrip()[:1]
        ends = (";", ";") if node.kind == Kind.FOR_STMT else (before, ")")
        if child.kind.is_expression() and before and before in "(;" and (before, after) == ends:
            negate(source, child, function)
            return


def remove_statement(source, node, holder, outer, function):
    """Removes what is a statement of its own in what holds it; `outer` is what holds that."""
    start, end = start_of(node), end_of(node)
    if node.kind == Kind.DECL_STMT:
        written = source.text[start:end].endswith(";")  # and not within a macro
        if written and holder.kind == Kind.COMPOUND_STMT and is_guard(source, node, holder):
            guard = GUARD.fullmatch(source.text[start:end])
            source.add(function, REMOVED, start, end - 1, "", *([(start, end)] if guard else []),
                       type=guard["type"] if guard else "")
        return
    if not node.kind.is_expression() and node.kind not in JUMPS:
        return
    if not source.text[end:].lstrip().startswith(";") or source.text[start:end].startswith(";"):
        return
    if holder.kind in LOOPS and node != list(holder.get_children())[-1]:
        return  # the head of a loop
    if node.kind == Kind.RETURN_STMT and (outer.kind in FUNCTIONS or outer.kind == Kind.LAMBDA_EXPR):
        return  # nothing would be returned
    source.add(function, REMOVED, start, end, "", (start, source.text.index(";", end) + 1))


def is_guard(source, node, holder):
    """Whether a declaration is there for what its object does as it comes and goes: nothing names it."""
    names = [child.spelling for child in node.get_children() if child.kind == Kind.VAR_DECL]
    rest = source.text[end_of(node):end_of(holder)]
    return bool(names) and not any(re.search(rf"\b{re.escape(name)}\b", rest) for name in names)
