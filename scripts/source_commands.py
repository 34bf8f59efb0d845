"""Checks commands for a developer's shell in the top folder without running them: they build for minutes, or wait for a
debugger's user. Each word that names a script, preset, target, test or program has to name one that exists. Used by
scripts/check-docs.
"""
import fnmatch
import json
import os
import pathlib
import re
import shlex

TEST = re.compile(r"\b(?:TYPED_)?TEST(?:_[FP])?\(\s*(\w+)\s*,\s*(\w+)|\bRC_GTEST_PROP\(\s*(\w+)\s*,\s*(\w+)")
ADDED_TEST = re.compile(r"\badd_test\(\s*NAME\s+([^\s)]+)")
OPERATORS = {"&&", "||", "|", ";"}
FLAGS = {
    "cmake": {"--build", "--install", "--workflow", "--preset", "--target", "--prefix", "--component", "--list-presets",
              "--fresh", "-j", "-G", "-S", "-B"},
    "ctest": {"--preset", "-R", "-E", "-N", "-V", "-j", "--output-on-failure"},
    "gdb": {"--args"},
}


class Tree:
    """What can be named in a source tree."""

    def __init__(self, root):
        self.root = pathlib.Path(root)
        presets = json.loads((self.root / "CMakePresets.json").read_text())
        self.presets = {kind: {preset["name"] for preset in presets.get(kind, []) if not preset.get("hidden")}
                        for kind in ("configurePresets", "buildPresets", "testPresets", "workflowPresets")}
        # Not rglob from the top, which would go through every build.
        folders = [file for file in self.root.iterdir() if file.is_dir() and file.name not in ("build", ".git")]
        lists = [self.root / "CMakeLists.txt", *(file for folder in folders for file in folder.rglob("CMakeLists.txt"))]
        self.lists = {file.parent.relative_to(self.root): file.read_text() for file in lists}
        self.settings = self.lists[pathlib.Path(".")]
        self.tests = {name for text in self.lists.values() for name in ADDED_TEST.findall(text)}
        for file in (self.root / "tests").rglob("*.cpp"):
            for match in TEST.finditer(file.read_text()):
                self.tests.add(".".join(word for word in match.groups() if word))

    def has_target(self, name, folder=None):
        texts = self.lists.values() if folder is None else [self.lists.get(folder, "")]
        return any(self.is_named(name, text) for text in texts)

    @staticmethod
    def is_named(name, text):
        # A function of the build may make the name up, as "${name}_fuzzer".
        stem, _, ending = name.rpartition("_")
        word = stem if stem and f"${{name}}_{ending}" in text else name
        return re.search(rf"(?<![\w-]){re.escape(word)}(?![\w-])", text) is not None

    def has_program(self, path):
        """A program below build/PRESET: its folder in the tree names it as a target."""
        parts = pathlib.PurePath(path).parts
        return (len(parts) >= 3 and parts[1] in self.presets["configurePresets"]
                and self.has_target(parts[-1], pathlib.Path(*parts[2:-1])))


def split(command):
    """The simple commands of a line, each a list of words."""
    words = shlex.split(command, comments=True)
    commands = [[]]
    for word in words:
        if word in OPERATORS:
            commands.append([])
        else:
            commands[-1].append(word)
    return [command for command in commands if command]


def preset_kind(words):
    if words[0] == "ctest":
        return "testPresets"
    return {"--build": "buildPresets", "--workflow": "workflowPresets"}.get(words[1], "configurePresets")


def check_tool(tree, words):
    """cmake and ctest: every option is known, every name after one exists."""
    position = 1
    while position < len(words):
        word = words[position]
        following = words[position + 1] if position + 1 < len(words) else ""
        if word.startswith("-D"):
            name = word[2:].split("=")[0].split(":")[0]
            if not name.startswith("CMAKE_") and not re.search(rf"\b{re.escape(name)}\b", tree.settings):
                yield f"no such setting: {name}"
        elif word not in FLAGS[words[0]]:
            yield f"{words[0]}: {word} is not known to scripts/source_commands.py"
        elif word == "--build" and following.startswith("build/"):
            position += 1
        elif word == "--preset":
            position += 1
            if following not in tree.presets[preset_kind(words)]:
                yield f"no such preset in {preset_kind(words)}: {following}"
        elif word == "--target":
            while position + 1 < len(words) and not words[position + 1].startswith("-"):
                position += 1
                if not tree.has_target(words[position]):
                    yield f"no such target: {words[position]}"
        elif word in ("-R", "-E"):
            position += 1
            if not any(re.search(following, test) for test in tree.tests):
                yield f"no test matches: {following}"
        elif word == "--install":
            position += 1
            if following not in {f"build/{name}" for name in tree.presets["configurePresets"]}:
                yield f"not the build folder of a preset: {following}"
        elif word == "-S":
            position += 1
            if pathlib.Path(following) not in tree.lists:
                yield f"{following} has no CMakeLists.txt"
        elif word in ("-B", "-G", "--prefix", "--component", "-j"):
            position += 1
        position += 1


def check_script(tree, words):
    script = tree.root / words[0]
    if not script.is_file() or not os.access(script, os.X_OK):
        yield f"no such script: {words[0]}"
        return
    for word in words[1:]:
        name = word.split("=")[0]
        if word.startswith("build/"):
            yield from check_program(tree, [word])
        elif not (tree.root / word).exists() and not re.search(rf"(?<![\w-]){re.escape(name)}(?![\w-])",
                                                               script.read_text()):
            yield f"{words[0]} does not know {word}"


def check_program(tree, words):
    if not tree.has_program(words[0]):
        yield f"no such program: {words[0]}"
    for word in words[1:]:
        if word.startswith("--gtest_filter="):
            patterns = word.split("=", 1)[1].split("-")[0].split(":")
            for pattern in patterns:
                if not any(fnmatch.fnmatchcase(test, pattern) for test in tree.tests):
                    yield f"no test matches: {pattern}"
        elif not word.startswith(("--benchmark_", "--gtest_")):
            yield f"{words[0]}: {word} is not known to scripts/source_commands.py"


def check_simple(tree, words):
    while words and re.match(r"\w+=", words[0]):
        words = words[1:]
    if not words:
        return
    if words[0].startswith(("scripts/", ".ci/")):
        yield from check_script(tree, words)
    elif words[0].startswith("build/"):
        yield from check_program(tree, words)
    elif words[0] == "gdb" and words[1:2] == ["--args"]:
        yield from check_program(tree, words[2:])
    elif words[0] in FLAGS and words[0] != "gdb":
        yield from check_tool(tree, words)
    else:
        yield f"{words[0]} is not known to scripts/source_commands.py"


def findings(tree, command):
    """What is wrong with a line of shell commands; empty when every name in it exists."""
    try:
        commands = split(command)
    except ValueError as error:
        return [f"{error}: {command}"]
    return [finding for words in commands for finding in check_simple(tree, words)]
