# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The package as a host meets it: installed into a folder of its own, found by CMake and by pkg-config, compiled against
# as C++17, linked and run. Every installed header compiles alone, without the folders of this project.
import concurrent.futures
import os
import shutil
import subprocess
import sys
import tempfile

if len(sys.argv) != 5:
    sys.exit("usage: installed_package.py CMAKE COMPILER BUILD_FOLDER PROJECT_ROOT")
CMAKE, COMPILER, BUILD, ROOT = sys.argv[1:]
HERE = os.path.dirname(os.path.abspath(__file__))
SHOT = os.path.join(ROOT, "examples", "data", "shot_010.fbx")
CAMERA = "shotCam"
FLAGS = ["-std=c++17", "-Wall", "-Wextra", "-Wpedantic", "-Werror"]


def run(*command, expect=0, env=None):
    result = subprocess.run(command, capture_output=True, text=True, timeout=120, env=env)
    if result.returncode != expect:
        sys.exit(f"{' '.join(command)}\nexit status {result.returncode}\n{result.stdout}{result.stderr}")
    return result.stdout


def headers_below(folder):
    return sorted(os.path.join(parent, name) for parent, _, names in os.walk(folder) for name in names
                  if name.endswith(".h"))


def check_all_headers_are_there(include):
    """The package has every public header of the sources, at its include path."""
    platform = os.path.join("fbxsdk", "include")
    for source, target in (("include", include), (platform, os.path.join(include, "platform"))):
        folder = os.path.join(ROOT, source)
        for header in headers_below(folder):
            installed = os.path.join(target, os.path.relpath(header, folder))
            if not os.path.exists(installed):
                sys.exit(f"not installed: {installed}")


def check_headers_compile_alone(include):
    def compile_one(header):
        run(COMPILER, *FLAGS, "-fsyntax-only", f"-I{include}", f"-I{include}/platform", "-include", header, "-x", "c++",
            os.devnull)

    headers = headers_below(include)
    if len(headers) < 50:
        sys.exit(f"only {len(headers)} headers in {include}")
    with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
        list(pool.map(compile_one, headers))
    return len(headers)


def check_programs(consumer, platform_consumer):
    names = run(consumer, SHOT).split("\n")
    if CAMERA not in names:
        sys.exit(f"the consumer does not see {CAMERA}: {names}")
    run(consumer, "there is no such file", expect=1)
    if int(run(platform_consumer, SHOT)) < 3:
        sys.exit("the consumer of the platform sees too few nodes")


def check_cmake(prefix, folder):
    build = os.path.join(folder, "build")
    run(CMAKE, "-S", os.path.join(HERE, "consumer"), "-B", build, f"-DCMAKE_PREFIX_PATH={prefix}",
        f"-DCMAKE_CXX_COMPILER={COMPILER}", "-DCMAKE_FIND_USE_PACKAGE_REGISTRY=OFF",
        f"-DCMAKE_CXX_FLAGS={' '.join(FLAGS[1:])}")
    run(CMAKE, "--build", build, "--parallel", "2")
    check_programs(os.path.join(build, "consumer"), os.path.join(build, "platform_consumer"))


def check_pkg_config(prefix, library_folder, folder):
    """Calls the compiler with the flags of pkg-config; the loader gets the folder, as for any library there."""
    tool = shutil.which("pkg-config")
    if not tool:
        print("no pkg-config here: not checked")
        return
    environment = dict(os.environ, PKG_CONFIG_PATH=os.path.join(library_folder, "pkgconfig"))
    flags = run(tool, "--cflags", "--libs", "tarnell-fbx", env=environment).split()
    if not any(flag.startswith("-I") and os.path.realpath(flag[2:]).startswith(prefix) for flag in flags):
        sys.exit(f"pkg-config points elsewhere: {flags}")
    program = os.path.join(folder, "by_hand")
    run(COMPILER, *FLAGS, os.path.join(HERE, "consumer", "main.cpp"), *flags, f"-Wl,-rpath,{library_folder}",
        "-o", program)
    if CAMERA not in run(program, SHOT).split("\n"):
        sys.exit(f"the program made by hand does not see {CAMERA}")


def check_tool(prefix):
    tool = os.path.join(prefix, "bin", "tarnell-fbx")
    if os.path.exists(tool) and CAMERA not in run(tool, "info", SHOT):
        sys.exit("the installed tool does not read")
    shells = ("man/man1/tarnell-fbx.1", "bash-completion/completions/tarnell-fbx", "zsh/site-functions/_tarnell-fbx",
              "fish/vendor_completions.d/tarnell-fbx.fish")
    for file in shells if os.path.exists(tool) else ():
        path = os.path.join(prefix, "share", file)
        if not os.path.exists(path) or "records" not in open(path, encoding="utf-8").read():
            sys.exit(f"not installed, or empty: {path}")


with tempfile.TemporaryDirectory() as work:
    work = os.path.realpath(work)
    prefix = os.path.join(work, "prefix")
    run(CMAKE, "--install", BUILD, "--prefix", prefix)
    include = os.path.join(prefix, "include", "tarnell-fbx")
    library_folder = next(parent for parent, _, names in os.walk(prefix) if "libtarnell-fbx.so" in names)
    check_all_headers_are_there(include)
    count = check_headers_compile_alone(include)
    check_cmake(prefix, work)
    check_pkg_config(prefix, library_folder, work)
    check_tool(prefix)
    print(f"{count} headers, two programs by CMake, one by hand")
