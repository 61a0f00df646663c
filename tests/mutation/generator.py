"""Makes mutants of C++ sources: each is one small mistake, found on clang's syntax tree and written into the text.

What stands in strings, comments, directives and macros is left alone, and so is what only declares: parameters, members,
enumerators, sizes of arrays, arguments of templates.
"""
import contextlib
import dataclasses
import re

from clang.cindex import CursorKind as Kind
from clang.cindex import Diagnostic, Index

import statements
from source import Source, full_name, start_of

SCOPES = (Kind.NAMESPACE, Kind.CLASS_DECL, Kind.STRUCT_DECL, Kind.UNION_DECL, Kind.CLASS_TEMPLATE,
          Kind.CLASS_TEMPLATE_PARTIAL_SPECIALIZATION, Kind.LINKAGE_SPEC, Kind.UNEXPOSED_DECL)
CLASSES = (Kind.CLASS_DECL, Kind.STRUCT_DECL, Kind.UNION_DECL, Kind.CLASS_TEMPLATE, Kind.CLASS_TEMPLATE_PARTIAL_SPECIALIZATION)
CONDITIONALS = (Kind.IF_STMT, Kind.WHILE_STMT, Kind.DO_STMT, Kind.FOR_STMT, Kind.CONDITIONAL_OPERATOR)
DECLARATIONS = (Kind.PARM_DECL, Kind.STATIC_ASSERT, Kind.FIELD_DECL, Kind.ENUM_DECL)


class CannotRead(Exception):
    """A source that clang does not understand as a whole: mutants would be missing."""


def walk_scope(source, node):
    for child in node.get_children():
        if source.holds(child):
            walk_declaration(source, child)


def walk_declaration(source, node):
    if node.kind in statements.FUNCTIONS:
        walk_function(source, node)
    elif node.kind == Kind.VAR_DECL:
        walk_variable(source, node, full_name(node))
    elif node.kind in SCOPES:
        walk_scope(source, node)


def walk_function(source, node):
    children = list(node.get_children())
    body = [child for child in children if child.kind in (Kind.COMPOUND_STMT, Kind.CXX_TRY_STMT)
            and source.text_of(child).startswith(("{", "try"))]  # and not what clang makes of = default
    if body and node.kind == Kind.CONSTRUCTOR:  # what its members begin with
        body = [child for child in children if child.kind.is_expression()] + body
    with computed_when_running(source, node):
        for child in body:
            walk(source, child, full_name(node), node, node)


def walk_variable(source, node, function):
    """What a variable begins with: behind its name, and not an array's size."""
    name_end = node.location.offset + len(node.spelling)
    if source.text[node.location.offset:name_end] != node.spelling:
        return  # made by a macro
    with computed_when_running(source, node):
        for child in node.get_children():
            between = source.text[name_end:start_of(child)]
            if start_of(child) >= name_end and not re.fullmatch(r"\s*(\[[^]]*\]\s*)*\[\s*", between):
                walk(source, child, function, node, node)


@contextlib.contextmanager
def computed_when_running(source, node):
    """While it lasts, mutants are found that a process can choose only without the declaration's constexpr or the like."""
    before = len(source.loosened)
    source.loosened += loosened(source, node)
    yield
    del source.loosened[before:]


def loosened(source, node):
    """What makes a function or variable one that is computed when running: inline where it was, and const."""
    head = source.text[start_of(node):node.location.offset]
    word = re.search(r"\bconst(expr|eval|init)\b", head)
    if not word:
        return
    is_variable = node.kind == Kind.VAR_DECL
    is_inline = not is_variable or node.semantic_parent.kind in CLASSES
    inline = "inline" if is_inline and not re.search(r"\binline\b", head) else ""
    if is_inline and is_variable:
        inline += ' __attribute__((visibility("hidden")))'  # a library that shares it with others could not be unloaded
    yield start_of(node) + word.start(), start_of(node) + word.end(), inline
    if is_variable and word[0] == "constexpr":
        yield node.location.offset, node.location.offset, "const "


def walk(source, node, function, holder, outer):
    """Statements and expressions; `holder` is what a node stands in, `outer` what that stands in."""
    kind = node.kind
    if kind in DECLARATIONS or kind.is_attribute() or not source.holds(node):
        return
    if kind == Kind.VAR_DECL:
        walk_variable(source, node, function)
        return
    if kind in SCOPES or kind in statements.FUNCTIONS:  # of a local class
        walk_declaration(source, node)
        return
    children = list(node.get_children())
    mutate(source, node, children, function, holder)
    for child in children:
        if kind in statements.HOLDERS:
            statements.remove_statement(source, child, node, holder, function)
        # What clang puts around an expression holds nothing.
        walk(source, child, function, *((holder, outer) if kind == Kind.UNEXPOSED_EXPR else (node, holder)))


def mutate(source, node, children, function, holder):
    if node.kind in (Kind.BINARY_OPERATOR, Kind.CALL_EXPR):
        statements.mutate_operator(source, children, function)
    elif node.kind == Kind.UNARY_OPERATOR:
        statements.drop_negation(source, node, function)
    elif node.kind in (Kind.INTEGER_LITERAL, Kind.CXX_BOOL_LITERAL_EXPR):
        statements.mutate_constant(source, node, function)
    elif node.kind == Kind.INIT_LIST_EXPR:
        statements.swap_rows(source, node, children, function, holder)
    elif node.kind in CONDITIONALS:
        statements.negate_condition(source, node, children, function)


def mutants_of(path, arguments, name=None):
    """The mutants of a source or header, in order; `arguments` are the compiler's."""
    unit = Index.create().parse(str(path), args=["-x", "c++", *arguments, "-Wno-pragma-once-outside-header"])
    errors = [each for each in unit.diagnostics if each.severity >= Diagnostic.Error]
    if errors:
        raise CannotRead(f"{errors[0].location.file}:{errors[0].location.line}: {errors[0].spelling}")
    source = Source(path)
    walk_scope(source, unit.cursor)
    return sorted(dataclasses.replace(each, file=name or source.name) for each in source.mutants)
