# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The README's code is the example that is built and run: fails when the two differ.
import pathlib
import re
import sys

root = pathlib.Path(sys.argv[1])
failures = 0
for path, code in re.findall(r"<!-- (\S+) -->\n```cpp\n(.*?)```", (root / "README.md").read_text(), re.S):
    source = (root / path).read_text()
    if not source.endswith(code):
        print(f"README.md: the code block of {path} is not what that file holds")
        failures += 1
sys.exit(failures > 0)
