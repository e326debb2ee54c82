"""Looks for mutants in small sources: mutators_test.py <script folder>"""

import sys

sys.dont_write_bytecode = True
sys.path.insert(0, sys.argv[1])
from mutators import mutants_of  # noqa: E402

# Why, a source, and what takes the place of what.
ROWS = [
    ("a relation, and the value returned", "bool f() { return a < b; }",
     ["< -> <=", "< -> >=", "a < b -> {}", "a < b -> true"]),
    ("a relation's negation is another one", "void f() { if (a == b) g(); }",
     ["== -> !=", "g(); -> ;"]),
    ("the negation of a call", "void f() { if (a()) g(); }",
     ["a() -> !(a())", "g(); -> ;"]),
    ("a joined condition", "void f() { while (a && !b) ++c; }",
     ["a && !b -> !(a && !b)", "&& -> ||", "! -> ", "++ -> --"]),
    ("of a loop the condition", "void f() { for (auto i = x; p(i);) g(i); }",
     ["p(i) -> !(p(i))", "g(i); -> ;"]),
    ("no declaration", "void f() { if (auto a = g()) T<int> b = g(); }", []),
    ("brackets, references, pointers", "A<T> f(T& a, T* b, T&& c);", []),
    ("numbers keep their suffix", "int f() { x(0x0f * 2U); y(010 + 0); }",
     ["x(0x0f * 2U); -> ;", "0x0f -> 16", "0x0f -> 14", "* -> /", "2U -> 3U",
      "2U -> 1U", "y(010 + 0); -> ;", "010 -> 9", "010 -> 7", "+ -> -",
      "0 -> 1"]),
    ("a constant returned", "int f() { return 1; } bool g() { return true; }",
     ["1 -> 2", "1 -> 0", "true -> false"]),
    ("a choice", "int f() { x = a() ? b : c; }",
     ["x = a() ? b : c; -> ;", "a() -> !(a())"]),
    ("a pointer and a qualified name begin statements",
     "void f() { *p = d; ::g(); a::b c(d); }", ["*p = d; -> ;", "::g(); -> ;"]),
    ("texts, comments and what only declares",
     '#if 1 < 2\n// 1 < 2\n/* 1 */ template <int n = 1>\nusing a = b<1>;\n'
     'static_assert(1 < 2);\nauto s = "1 < 2" + R"x(1 )" < 2)x";', ["+ -> -"]),
    ("no definition, an operator's name",
     "virtual int f() const = 0; bool operator < (T);", []),
    ("as many lines as before", "void f() {\n  g(a,\n    b);\n}",
     ["g(a,\n    b); -> ;"]),
]

for why, source, wanted in ROWS:
    mutants = mutants_of("x.cpp", source)
    found = [f"{source[m.start:m.end]} -> {m.text}" for m in mutants]
    if sorted(found) != sorted(wanted):
        sys.exit(f"{why}:\n  found  {sorted(found)}\n  wanted {sorted(wanted)}")
    for mutant in mutants:
        if mutant.mutated().count("\n") != source.count("\n"):
            sys.exit(f"{why}: lines are lost by {mutant.change}")
