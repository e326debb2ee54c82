"""Model documents at random, for trying the C of hx_codegen.

    document(random.Random(7), 7, words)   # a dict, mostly accepted

Names are hostile on purpose: reserved words, include guards, main, names of the
library and of the compiler, names that agree in 31 characters.
"""

import math

C_TYPES = ["signed char", "unsigned char", "short", "unsigned short", "int",
           "unsigned int", "float", "double"]
MODELS = ["d{}", "d{}", "d{}", "_d{}", "9d{}", "d-{}", "Größe {}", "int", "main",
          "printf", "D{}", "a/b {}", "__d{}", "d{}" + "_long" * 36]
FLOATS = [0, -0.0, 0.5, 1, -1, 2.5, 1e-40, 5e-324, -1e300, 1.7976931348623157e308,
          2147483647, -2147483648, 4294967296, 9.3e18, 1e-7, 3.4028235677973366e38]
# By qualifiers: all variables of a section have the same.
SECTIONS = {"": ["fast", ".data.fast", ".nv"], "c": [".rodata.map", ".calib"],
            "v": ["shared", ".data.io"], "cv": ["tunable"]}


class Maker:
    """One document; `rare` is the share of hostile choices."""

    def __init__(self, random, number, words):
        self.random = random
        self.number = number
        self.words = words
        self.rare = random.choice([0, 0.03, 0.3])
        self.used = set()
        self.type_ids = []

    def chance(self, share):
        return self.random.random() < share

    def hostile(self):
        n = self.number
        return self.random.choice([
            self.random.choice(self.words), self.random.choice(self.words),
            "main", f"D{n}_H", f"D{n}_TYPES_H", "__LINE__", "_Bool", "__x86_64__",
            "linux", "HX_SECTION", "HX_ALIGNED", "int16_t", "INT_MAX", "FLT_MAX",
            "size_t", "hx_no_definitions", "_x", "__" + "y" * 40,
            "agree_in_thirty_one_characters_" + str(n % 3)])

    def given(self, kind):
        """A name for a type, a constant or a field."""
        name = self.hostile() if self.chance(self.rare / 20) else (
            f"{kind}{len(self.used)}")
        if name in self.used:
            name = f"{kind}{len(self.used)}"
        self.used.add(name)
        return name

    def template(self, kind, index):
        if self.chance(self.rare):
            return self.hostile() + self.random.choice(["", "", ":$R", "$R"])
        return self.random.choice([
            f"d{self.number}_{kind}{index}", f"d{self.number}_$B_$S$R",
            f"d{self.number}_" + "x" * self.random.randrange(300),
            f"d{self.number} " + self.random.choice(["ä", "*/", "a b", "??/"])])

    def types(self):
        types = []
        for i, c in enumerate(C_TYPES):
            name = self.given("Base")
            if self.chance(self.rare) and i < 6:
                name = ["int8_t", "uint8_t", "int16_t", "uint16_t", "int32_t",
                        "uint32_t"][i]
            types.append({"id": f"b{i}", "name": name, "kind": "base", "c": c,
                          "cut": self.random.choice(["", "x"])})
        types.append({"id": "l", "name": self.given("Long"), "kind": "integer64",
                      "signed": self.chance(0.5)})
        declarable = [t["id"] for t in types]
        for i in range(self.random.randrange(3)):
            types.append({"id": f"bit{i}", "name": self.given("Bit"),
                          "kind": "bitField",
                          "bits": self.random.choice([1, 2, 7, 16, 31, 32])})
        bits = [t["id"] for t in types if t["kind"] == "bitField"]
        for i in range(self.random.randrange(14)):
            kind = self.random.choice(["derived", "numerical", "array", "struct",
                                       "enum"])
            entry = {"id": f"t{i}", "name": self.given("Type"), "kind": kind}
            if kind in ("derived", "numerical"):
                entry["of"] = self.random.choice(declarable)
                if kind == "derived":
                    entry["of"] = f"b{self.random.randrange(8)}"
            elif kind == "array":
                entry["of"] = self.random.choice(declarable)
                entry["length"] = self.random.choice([1, 2, 3, 5, 40])
            elif kind == "enum":
                entry["values"] = [
                    {"name": self.given("E"), "value": value} for value in
                    [0, 1] + self.random.sample([-1, 32767, -32767, 7], 2)]
            else:
                entry["fields"] = [
                    {"name": self.given("f"),
                     "type": self.random.choice(declarable + bits)}
                    for _ in range(self.random.randrange(1, 6))]
            types.append(entry)
            declarable.append(entry["id"])
        self.declarable = declarable
        self.room = {}
        for entry in types:
            self.room[entry["id"]] = entry.get("length", 1) * (
                sum(self.room[f["type"]] for f in entry["fields"])
                if "fields" in entry else self.room.get(entry.get("of"), 1))
        self.random.shuffle(types)
        return types

    def scopes(self, functions):
        def blocks(prefix, depth):
            return [{"id": f"{prefix}.{i}", "kind": "block",
                     "scopes": blocks(f"{prefix}.{i}", depth + 1)}
                    for i in range(self.random.randrange(3) if depth < 3 else 0)]

        inner = [{"id": f"s{i}", "kind": "function", "function": f"F{i}",
                  "scopes": blocks(f"s{i}", 0)}
                 for i in range(functions) if self.chance(0.7)]
        ids = ["file"]

        def collect(scopes):
            for scope in scopes:
                ids.append(scope["id"])
                collect(scope["scopes"])
        collect(inner)
        return [{"id": "file", "kind": "file", "scopes": inner}], ids

    def number_value(self):
        if self.chance(0.5):
            return self.random.choice(FLOATS)
        return math.ldexp(self.random.random() - 0.5, self.random.randrange(-60, 66))

    def variable(self, index, scopes, functions, enums):
        """With enumerations, values are 0 or 1: every enumeration has both."""
        entry = {"id": f"v{index}", "template": self.template("v", index),
                 "kind": "variable", "type": self.random.choice(self.declarable),
                 "scope": self.random.choice(scopes + ["file"] * len(scopes)),
                 "source": f"b{self.random.randrange(3)}"}
        if self.chance(0.6):
            room = self.room[entry["type"]]
            count = self.random.choice([1, room, self.random.randint(1, room),
                                        room + self.chance(0.02)])
            values = [self.random.randrange(2) if enums else self.number_value()
                      for _ in range(count)]
            entry["initial"] = values if count > 1 else values[0]
        if self.chance(0.2):
            entry["lsb"] = self.random.choice([0.5, 1e-300, 3, 1e300])
            entry["zero"] = self.number_value()
        for word in ("const", "volatile"):
            if self.chance(0.15):
                entry[word] = True
        if self.chance(0.15) and (functions or entry["scope"] != "file"):
            entry["static"] = True
        if self.chance(0.1):
            entry["alignment"] = self.random.choice([1, 2, 16, 64, 4096])
        if self.chance(0.1) and (entry["scope"] == "file" or "static" in entry):
            qualifiers = "c" * ("const" in entry) + "v" * ("volatile" in entry)
            entry["section"] = self.random.choice(
                SECTIONS[qualifiers if self.chance(0.95) else "c"])
        if self.chance(0.3):
            entry["unit"] = self.random.choice(["km/h", "*/", "µ\u202e", "m??/"])
        return entry


def document(random, number, words):
    make = Maker(random, number, words)
    model = {"model": {"name": random.choice(MODELS).format(number),
                       "systemId": "a"}, "options": {}}
    options = model["options"]
    if make.chance(0.5):
        options["limitNames"] = True
    if make.chance(0.5):
        code = options["code"] = {
            word: make.chance(0.5) for word in ("stdint", "checkWidths", "banner")}
        if make.chance(0.5):
            code["comments"] = random.sample(["id", "path", "unit"],
                                             random.randrange(4))
    model["blocks"] = [
        {"id": f"b{i}", "name": random.choice(
            ["Gain", "a*/b", "??/", "Größe", "\u202eevil", "x" * 900, "你好",
             "a\\", "//", "w " * 600])} for i in range(3)]
    functions = random.choice([0, 1, 1, 2, 4])
    if make.chance(0.95):
        model["types"] = make.types()
    model["scopes"], scopes = make.scopes(functions)
    model["names"] = [{"id": f"F{i}", "template": make.template("F", i),
                       "kind": random.choice(["function", "task", "isr"])}
                      for i in range(functions)]
    if "types" in model and make.chance(0.95):
        enums = any(t["kind"] == "enum" for t in model["types"])
        model["names"] += [make.variable(i, scopes, functions, enums)
                           for i in range(random.randrange(25))]
    return model
