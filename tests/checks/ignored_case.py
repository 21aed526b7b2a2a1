# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Hosts compile on a file system that ignores case, where <fbxsdk.h> and "FbxSdk.h" name the same file of a folder.
#   ignored_case.py COMPILER PROJECT_ROOT
#
# The public headers are copied, and every name by which one of them is included gets a link to the file that such a file
# system would find for it.
import os
import re
import subprocess
import sys
import tempfile
from pathlib import Path
from shutil import copytree

INCLUDE = re.compile(r'^[ \t]*#[ \t]*include[ \t]*[<"]([^>"]+)[>"]', re.MULTILINE)
USES_BOTH = """
const char* nameOf(const fbxsdk::FbxNode& node) { return node.GetName(); }
fbxsdk::FbxScene* sceneOf(const Tarnell::Fbx::FbxSdk& sdk) { return sdk.getScene(); }
"""
HOSTS = {
    "the adapter": "#include <FbxSdk.h>" + USES_BOTH,
    "the adapter, quoted": '#include "FbxSdk.h"' + USES_BOTH,
    "the platform first": "#include <fbxsdk.h>\n#include <FbxSdk.h>" + USES_BOTH,
    "the platform last": "#include <Fbx.h>\n#include <FbxSdk.h>\n#include <fbxsdk.h>" + USES_BOTH,
    "the faithful adapter": "#include <FbxFaithful.h>\nfbxsdk::FbxScene* of(Tarnell::Fbx::FbxFaithful& file)"
                            " { return file.getScene(); }",
}


def ignore_case(folder, names):
    """Links each name to the file that differs from it only by case."""
    files = {str(path.relative_to(folder)).lower(): path for path in folder.rglob("*.h")}
    for name in names:
        path = files.get(name.lower())
        if path and not (folder / name).exists():
            (folder / name).parent.mkdir(parents=True, exist_ok=True)
            os.symlink(path, folder / name)


def overlay(root, target):
    """The folders in which a host searches, in this order."""
    library, platform = target / "library", target / "platform"
    copytree(root / "include", library)
    copytree(root / "fbxsdk/include", platform)
    headers = [*library.rglob("*.h"), *platform.rglob("*.h")]
    names = {name for path in headers for name in INCLUDE.findall(path.read_text(encoding="utf-8"))}
    for folder in (library, platform):
        ignore_case(folder, names | {"FbxSdk.h", "fbxsdk.h"})
    return library, platform


def errors(compiler, folders, host):
    command = [compiler, "-std=c++17", "-fsyntax-only", *(f"-I{folder}" for folder in folders), "-x", "c++", "-"]
    result = subprocess.run(command, input=host, capture_output=True, text=True, check=False)
    return result.stderr if result.returncode else ""


def main():
    compiler, root = sys.argv[1], Path(sys.argv[2]).resolve()
    with tempfile.TemporaryDirectory() as target:
        folders = overlay(root, Path(target))
        found = [f"{name}: {text}" for name, host in HOSTS.items() if (text := errors(compiler, folders, host))]
        print("\n".join(found))
        # With the plain name the adapter's header would find itself: otherwise nothing was tried here.
        header = folders[0] / "FbxPlatform.h"
        header.write_text("#pragma once\n#include <fbxsdk.h>\n", encoding="utf-8")
        if not errors(compiler, folders, HOSTS["the adapter"]):
            sys.exit("a header that includes <fbxsdk.h> compiles: case is not ignored")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
