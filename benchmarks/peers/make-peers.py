#!/usr/bin/env python3
"""Writes the benchmarks' reference decoders from the schema: make-peers.py FOLDER SCHEMA…

FOLDER/peer/*.proto   the schema in a separate package, for protobuf's generated classes
FOLDER/AllMessages.h  the headers of our message classes
FOLDER/Peers.h        what a careful programmer would write by hand for each message with protozero: a reader into a
                      plain struct and a reader directly into a dictionary; and protobuf's accessors into a dictionary
"""
import pathlib
import re
import sys

GETTERS = {"uint64": "get_uint64", "uint32": "get_uint32", "sint32": "get_sint32", "bool": "get_bool",
           "string": "get_view", "bytes": "get_view"}
STORED = {"uint64": "std::uint64_t", "uint32": "std::uint32_t", "sint32": "std::int32_t", "bool": "bool",
          "string": "Text", "bytes": "Text"}


def parse(text):
    """Enumerations as {name: [(value, number)]}, messages as [(name, [(label, type, name, number)])]."""
    enums, messages, scope = {}, [], []
    for line in text.splitlines():
        line = line.split("//")[0].strip()
        if match := re.fullmatch(r"(message|enum) (\w+) \{", line):
            scope.append((match[1], match[2]))
            if match[1] == "message":
                messages.append((match[2], []))
            else:
                enums[match[2] if len(scope) == 1 else f"{scope[0][1]}_{match[2]}"] = []
        elif line == "}":
            scope.pop()
        elif match := re.fullmatch(r"(optional|repeated) (\w+) (\w+) = (\d+)( \[.*\])?;", line):
            messages[-1][1].append((match[1], match[2], match[3], int(match[4])))
        elif match := re.fullmatch(r"(\w+) = (-?\d+);", line):
            enums[list(enums)[-1]].append((match[1], int(match[2])))
    return enums, messages


def main():
    folder = pathlib.Path(sys.argv[1])
    (folder / "peer").mkdir(parents=True, exist_ok=True)
    enums, messages, headers = {}, [], []
    for path in map(pathlib.Path, sys.argv[2:]):
        text = path.read_text(encoding="utf-8")
        (folder / "peer" / path.name).write_text(
            text.replace("package vespscope;", "package peer;").replace('import "', 'import "peer/'), encoding="utf-8")
        some_enums, some_messages = parse(text)
        enums.update(some_enums)
        messages.extend(some_messages)
        headers += [f'#include "messages/{path.stem}/{name}.h"' for name, _ in some_messages]
    fields_of = dict(messages)
    ordered, done = [], set()

    def visit(name):
        if name in done:
            return
        done.add(name)
        for _, kind, _, _ in fields_of[name]:
            if kind in fields_of:
                visit(kind)
        ordered.append(name)

    for name, _ in messages:
        visit(name)

    out = ["// Written by make-peers.py.", "#pragma once", "#include <cstdint>", "#include <optional>",
           "#include <string_view>", "#include <vector>", "#include <protozero/pbf_reader.hpp>"]
    out += [f'#include "peer/{pathlib.Path(path).stem}.pb.h"' for path in sys.argv[2:]]
    out += ["namespace peers {"]
    for name, values in enums.items():
        out.append(f"inline std::string_view nameOf{name}(std::int32_t number) {{ switch (number) {{")
        seen = set()
        for value, number in values:
            if number not in seen:
                out.append(f'case {number}: return "{value}";')
            seen.add(number)
        out.append("default: return {}; } }")

    for name in ordered:
        fields = fields_of[name]

        def enum_of(kind):
            return f"{name}_{kind}" if f"{name}_{kind}" in enums else kind

        # The struct.
        members, cases, clears, bit = [], [], ["has = 0;"], 0
        for label, kind, field, number in fields:
            if kind in fields_of:
                if label == "repeated":
                    members.append(f"std::vector<{kind}<Text>> {field};")
                    cases.append(f"case {number}: {field}.emplace_back().read(in.get_message()); break;")
                else:
                    members.append(f"std::optional<{kind}<Text>> {field};")
                    cases.append(f"case {number}: {field}.emplace().read(in.get_message()); break;")
                clears.append(f"{field}.{'clear' if label == 'repeated' else 'reset'}();")
            elif label == "repeated":
                members.append(f"std::vector<{STORED[kind]}> {field};")
                cases.append(f"case {number}: for (const auto value : in.get_packed_{kind}()) {field}.push_back(value); "
                             "break;")
                clears.append(f"{field}.clear();")
            else:
                stored = STORED.get(kind, "std::int32_t")
                getter = GETTERS.get(kind, "get_enum")
                members.append(f"{stored} {field}{{}};")
                value = f"in.{getter}()"
                if kind in ("string", "bytes"):
                    value = f"textOf<Text>({value})"
                cases.append(f"case {number}: {field} = {value}; has |= 1U << {bit}; break;")
                bit += 1
        out.append(f"template <class Text> struct {name} {{ std::uint32_t has = 0;")
        out += members
        out.append("void read(protozero::pbf_reader in) { while (in.next()) { switch (in.tag()) {")
        out += cases
        out.append("default: in.skip(); } } }")
        out.append("void clear() { " + " ".join(clears) + " } };")

        # Reads directly into a dictionary.
        out.append(f"template <class Dictionary> void read{name}(protozero::pbf_reader in, Dictionary& out) {{")
        out.append(f"out.reserve({len(fields)}); while (in.next()) {{ switch (in.tag()) {{")
        for label, kind, field, number in fields:
            if kind in fields_of:
                place = f'out.{"element" if label == "repeated" else "embedded"}("{field}")'
                out.append(f"case {number}: read{kind}(in.get_message(), {place}); break;")
            elif label == "repeated":
                out.append(f'case {number}: out.numbers("{field}", in.get_packed_{kind}()); break;')
            elif kind in GETTERS:
                add = {"string": "text", "bytes": "bytes"}.get(kind, "number")
                out.append(f'case {number}: out.{add}("{field}", in.{GETTERS[kind]}()); break;')
            else:
                out.append(f'case {number}: {{ const auto number = in.get_enum(); out.enumeration("{field}", '
                           f"nameOf{enum_of(kind)}(number), number); break; }}")
        out.append("default: in.skip(); } } }")

        # Copies Protobuf's accessors into a dictionary.
        out.append(f"template <class Dictionary> void copy{name}(const peer::{name}& in, Dictionary& out) {{")
        out.append(f"out.reserve({len(fields)});")
        for label, kind, field, _ in sorted(fields, key=lambda each: each[3]):
            low = field.lower()
            if kind in fields_of:
                if label == "repeated":
                    out.append(f'for (const auto& each : in.{low}()) copy{kind}(each, out.element("{field}"));')
                else:
                    out.append(f'if (in.has_{low}()) copy{kind}(in.{low}(), out.embedded("{field}"));')
            elif label == "repeated":
                out.append(f'if (in.{low}_size() > 0) out.numbers("{field}", in.{low}());')
            elif kind in GETTERS:
                add = {"string": "text", "bytes": "bytes"}.get(kind, "number")
                out.append(f'if (in.has_{low}()) out.{add}("{field}", in.{low}());')
            else:
                out.append(f'if (in.has_{low}()) out.enumeration("{field}", nameOf{enum_of(kind)}(in.{low}()), '
                           f"in.{low}());")
        out.append("}")
    tops = [name for name, _ in messages if name.startswith("KCellular")]
    out.append("}  // namespace peers")
    out.append("#define FOR_EACH_PEER(X) " + " ".join(f"X({name})" for name in tops))
    text = "\n".join(out) + "\n"
    text = text.replace("namespace peers {\n",
                        "namespace peers {\n"
                        "template <class Text> Text textOf(protozero::data_view view) "
                        "{ return Text(view.data(), view.size()); }\n", 1)
    (folder / "Peers.h").write_text(text, encoding="utf-8")
    (folder / "AllMessages.h").write_text("\n".join(headers) + "\n", encoding="utf-8")


main()
