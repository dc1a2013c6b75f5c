#!/usr/bin/env python3
"""Writes Java classes that have the signatures of the platform's public API, from the text in which it is published.

    classes_of_api.py current.txt OUTPUT SOURCE...

Writes the classes that the sources import or use from their own package, and the classes that these need. Of their
members it writes those whose names occur in the sources. A method does nothing, and returns null or zero; a static
method that returns its own class returns a new object, if that has a constructor without parameters.
"""
import pathlib
import re
import sys

api, output, *sources = map(pathlib.Path, sys.argv[1:])
text = "\n".join(source.read_text() for source in sources)
words = set(re.findall(r"\w+", text))


def without_annotations(line):
    while (found := re.search(r"@(?!interface)[\w.]+(\((?:[^()]|\([^()]*\))*\))? ?", line)):
        line = line[: found.start()] + line[found.end() :]
    return line


# Declarations and members without annotations, by the full name of the class.
classes = {}
package = None
for line in api.read_text().splitlines():
    line = without_annotations(line.strip().rstrip(";"))
    if line.startswith("package "):
        package = line.split()[1]
    elif not package or package.startswith("java."):
        continue
    elif re.search(r"\b(class|interface|enum) .*\{$", line):
        name = package + "." + re.search(r"\b(?:class|interface|enum) ([\w.]+)", line)[1]
        classes[name] = (line[:-1].replace("abstract static interface", "static interface"), members := [])
    elif line.startswith(("ctor ", "method ", "field ", "enum_constant ")):
        members.append(line)


def named(signature):
    """Returns the classes of the API that a piece of text names."""
    return {name for name in re.findall(r"\b[a-z]\w*(?:\.\w+)+", signature) if name in classes}


def supertypes(name):
    declaration = classes[name][0]
    if re.search(r"\binterface\b", declaration):
        return declaration
    declaration, _, interfaces = re.sub(r"<.*?>", "", declaration).partition(" implements ")
    kept = sorted(named(interfaces) & wanted)
    return declaration + (" implements " + ", ".join(kept) if kept else "")


def taken(name):
    is_interface = " interface " in " " + classes[name][0]
    for member in classes[name][1]:
        signature, _, value = member.partition(" = ")
        called = re.search(r"(\w+)(?:\(| =|$)", signature)[1]
        if is_interface and "field" not in signature or member.startswith("ctor") or called in words:
            yield member


wanted = set()
unimported = words - set(re.findall(r"^import .*\.(\w+);", text, re.M))
of_same_package = {package + "." + word for package in re.findall(r"^package (.*);", text, re.M) for word in unimported}
due = {name for name in classes if re.search(r"import (static )?" + re.escape(name) + r"[.;]", text)
       or name in of_same_package or "." in name and name in text}
while due - wanted:
    name = (due - wanted).pop()
    wanted.add(name)
    if " interface " in " " + classes[name][0]:
        # Classes that implement an interface have its methods.
        words |= {found[1] for member in classes[name][1] if (found := re.search(r"(\w+)\(", member))}
        due |= {other for seen in wanted for member in taken(seen) for other in named(member)}
    outer = name.rpartition(".")[0]
    due |= {outer} & classes.keys()
    due |= {inner for inner in classes if inner.startswith(name + ".") and ".".join(inner.split(".")[-2:]) in text}
    due |= named(supertypes(name).partition(" implements ")[0])
    for member in taken(name):
        due |= named(member)


def value_of(kind):
    if kind == "boolean":
        return "false"
    return "0" if kind in {"byte", "char", "short", "int", "long", "float", "double"} else f"({kind}) null"



def call_of_super(name):
    parent = re.search(r" extends ([\w.]+)", classes[name][0])
    if not parent or parent[1] not in classes:
        return ""
    for member in classes[parent[1]][1]:
        if member.startswith("ctor"):
            kinds = [kind for kind in re.search(r"\((.*)\)", member)[1].replace("...", "[]").split(", ") if kind]
            return "super(" + ", ".join(value_of(kind) for kind in kinds) + ");"
    return ""


def java_of(member, name, abstract_allowed):
    kind, _, rest = member.partition(" ")
    simple = name.rpartition(".")[2]
    if kind == "enum_constant":
        return ""
    if kind == "field":
        signature, has_value, value = rest.partition(" = ")
        if not has_value:
            type_name = signature.split()[-2]
            value = value_of(type_name) if type_name != "int" else 'Integer.parseInt("0")'
        elif signature.split()[-2] == "float" and not value.endswith("f"):
            value += "f"
        else:
            value = re.sub(r" // .*", "", value).rstrip("; ")
        return f"{signature} = {value};" if "final" in signature else f"{signature};"
    head, _, tail = rest.partition("(")
    count = iter(range(100))
    parameters, _, thrown = tail.rpartition(")")
    parameters = re.sub(r"(, (?![^<]*>)|$)", lambda end: f" p{next(count)}" + end[0], parameters) if parameters else ""
    if kind == "ctor":
        return f"{head.rsplit(' ', 1)[0]} {simple}({parameters}){thrown} {{ {call_of_super(name)} }}"
    if abstract_allowed and "default" not in head and "static" not in head or "abstract" in head:
        return f"{head}({parameters}){thrown};"
    result = head.split()[-2]
    if "static" in head and result == name and f"ctor public {simple}()" in classes[name][1]:
        return f"{head}({parameters}){thrown} {{ return new {simple}(); }}"
    body = "" if result == "void" else f"return {value_of(result).rpartition(' ')[2]};"
    return f"{head}({parameters}){thrown} {{ {body} }}"


def write(name, indent):
    declaration = supertypes(name)
    simple = name.rpartition(".")[2]
    declaration = re.sub(r"(class|interface|enum) [\w.]+", rf"\1 {simple}", declaration)
    is_interface = " interface " in " " + declaration
    yield f"{indent}{declaration} {{"
    if " enum " in " " + declaration:
        constants = [m.split()[-1] for m in classes[name][1] if m.startswith("enum_constant")]
        yield f"{indent}    {', '.join(constants)};"
    if call_of_super(name) and not any(member.startswith("ctor") for member in classes[name][1]):
        yield f"{indent}    protected {simple}() {{ {call_of_super(name)} }}"
    for member in taken(name):
        if " enum " not in " " + declaration or "valueOf" not in member and "values" not in member:
            yield f"{indent}    {java_of(member, name, is_interface)}"
    for inner in sorted(wanted):
        if inner.rpartition(".")[0] == name:
            yield from write(inner, indent + "    ")
    yield f"{indent}}}"


for name in sorted(wanted):
    outer, _, simple = name.rpartition(".")
    if outer in classes:
        continue
    path = output / (name.replace(".", "/") + ".java")
    path.parent.mkdir(parents=True, exist_ok=True)
    path.write_text(f"package {outer};\n\n" + "\n".join(write(name, "")) + "\n")
