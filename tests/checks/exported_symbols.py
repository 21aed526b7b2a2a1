# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# What the shared libraries export: only names of their own. Platform symbols carry the inline namespace, so that they
# never meet those of another SDK in one process.
#   exported_symbols.py LIBRARY PREFIX...   every exported symbol must contain one of the prefixes
import subprocess
import sys

library, prefixes = sys.argv[1], sys.argv[2:]
listing = subprocess.run(["nm", "-D", "--defined-only", "-C", library], capture_output=True, text=True, check=True)
symbols = [line.split(None, 2)[2] for line in listing.stdout.splitlines() if len(line.split(None, 2)) == 3]
# Weak instances of standard templates are shared by every C++ library.
standard = ("std::", "__gnu_cxx::", "typeinfo", "vtable", "operator new", "operator delete", "void std::", "bool std::",
            "decltype", "__asan", "__ubsan", "__tsan", "_init", "_fini")
foreign = [name for name in symbols if not any(p in name for p in prefixes) and not name.startswith(standard)]
if not symbols:
    print(f"{library}: exports nothing")
    sys.exit(1)
for name in foreign[:20]:
    print(f"{library}: exports {name}")
sys.exit(1 if foreign else 0)
