#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Shows what exported_symbols.py refuses."""

import subprocess
import tempfile
import unittest
from pathlib import Path

from exported_symbols import ROOT, SETTINGS, functions_and_classes, missing_calls, name_of, violations

HEADER = """
namespace house {
namespace detail { class Hidden { public: void call(); }; }
class Door {
public:
    Door();
    virtual ~Door();
    void open(int width);
    void open(double width);
    bool isOpen() const { return true; }
    Door(const Door&) = delete;
    template <class Key> bool fits(const Key& key);
    Door& operator<<(int key);
protected:
    void creak();
private:
    void open(const char* key);
    void oil();
    static int count;
};
int number();
}
"""
PUBLIC = ["house::Door::Door()", "house::Door::~Door()", "house::Door::open(int)", "house::Door::open(double)",
          "house::Door::operator<<(int)", "house::number()", "vtable for house::Door", "typeinfo name for house::Door"]


class ExportedSymbols(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        with tempfile.TemporaryDirectory() as folder:
            (Path(folder) / "Door.h").write_text(HEADER, encoding="utf-8")
            settings = (ROOT / "docs/api/common.doxyfile").read_text(encoding="utf-8") + SETTINGS
            settings += f"INPUT = {folder}\nOUTPUT_DIRECTORY = {folder}\n"
            subprocess.run(["doxygen", "-"], input=settings, text=True, check=True, capture_output=True)
            cls.declared = functions_and_classes(Path(folder) / "xml")

    def check(self, symbols, exceptions=()):
        return list(violations(symbols, *self.declared, exceptions))

    def test_accepts_what_is_public(self):
        self.assertEqual(self.check(PUBLIC), [])

    def test_refuses_private_and_protected_members(self):
        for symbol in ("house::Door::oil()", "house::Door::creak()", "house::Door::count"):
            self.assertEqual(self.check([*PUBLIC, symbol]), [f"exported, but not public: {symbol}"])

    def test_refuses_a_private_overload_of_a_public_function(self):
        self.assertEqual(len(self.check([*PUBLIC, "house::Door::open(char const*)"])), 1)

    def test_refuses_internals_and_names_of_others(self):
        for symbol in ("house::detail::Hidden::call()", "typeinfo for house::detail::Hidden",
                       "void std::sort<int*>(int*, int*)", "vtable for std::thread", "cellar()"):
            self.assertEqual(len(self.check([*PUBLIC, symbol])), 1, symbol)

    def test_accepts_instances_of_public_templates(self):
        instances = ["bool house::Door::fits<int>(int const&)", "bool house::Door::fits<char>(char const&)"]
        self.assertEqual(self.check([*PUBLIC, *instances]), [])

    def test_accepts_exceptions(self):
        self.assertEqual(self.check([*PUBLIC, "house::Door::oil()"], [(r"house::Door::oil", "why")]), [])

    def test_refuses_that_functions_in_headers_call_what_is_missing(self):
        self.assertEqual(list(missing_calls(["house::Door::oil()"], [*PUBLIC, "house::Door::oil()"])), [])
        self.assertEqual(len(list(missing_calls(["house::Door::oil()"], PUBLIC))), 1)

    def test_refuses_public_functions_that_are_missing(self):
        for missing in ("house::number()", "house::Door::operator<<(int)", "house::Door::Door()"):
            found = self.check([symbol for symbol in PUBLIC if symbol != missing])
            self.assertEqual(found, [f"public, but not exported: {name_of(missing)}"])


class Names(unittest.TestCase):
    def test_are_without_results_arguments_and_template_arguments(self):
        for symbol, name in (
            ("bool a::B<int>::read<c::D>(c::D&, std::vector<int>&)", "a::B::read"),
            ("a::B::operator()(int) const", "a::B::operator()"),
            ("a::operator<(a::B const&, a::B const&)", "a::operator<"),
            ("a::B::operator char const*() const", "a::B::operator char const*"),
            ("fbxsdk::tarnell::FbxNode::ClassId", "fbxsdk::FbxNode::ClassId"),
            ("typeinfo name for a::B<int>", "a::B"),
            ("a::B::kName[abi:cxx11]", "a::B::kName"),
        ):
            self.assertEqual(name_of(symbol), name)


if __name__ == "__main__":
    unittest.main()
