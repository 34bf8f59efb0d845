"""What scripts/check-docs accepts and refuses, on a small tree with a program that prints its arguments."""
import json
import pathlib
import tempfile
import unittest

from loading import load

CHECK_DOCS = load("check-docs")

PROGRAM = """#!/bin/sh
case "$*" in
--help) printf '  --help  Help\\n\\nSubcommands:\\n  dsd  Screening designs\\n' ;;
"dsd --help") echo '  --factors COUNT' ;;
*) echo "runs: $*" ;;
esac
"""
TREE = {
    "bin/reisti": PROGRAM,
    "scripts/demo": "#!/bin/sh\n# usage: scripts/demo [--quick]\n",
    "include/reisti/reisti.h": "int des_Version(void);\n",
    "examples/host.c": "int main(void) {\n    return des_Version();\n}\n",
    "src/table.cpp": "namespace lib { int numFactors; }\nconst char* column = \"std_order\";\n",
    "examples/CMakeLists.txt": "find_package(reisti REQUIRED)\n",
    "tests/install/build_consumer": "cc -std=c99 host.c \\\n    -lreisti\n",
    "tests/unit/dsd/CMakeLists.txt": "reisti_add_test(NAME unit_dsd)\nadd_test(NAME CHost.Builds COMMAND unit_dsd)\n",
    "tests/unit/dsd/rows_test.cpp": "TEST(RowCount, OfSixFactorsIsThirteen) {}\n",
    "fuzz/CMakeLists.txt": "add_executable(${name}_fuzzer)\nadd_fuzzer(rows)\n",
    "CMakeLists.txt": "option(REISTI_DEVELOPER \"\" OFF)\n",
    "CMakePresets.json": json.dumps({
        "configurePresets": [{"name": "base", "hidden": True}, {"name": "dev"}],
        "buildPresets": [{"name": "dev"}],
        "testPresets": [{"name": "dev"}],
        "workflowPresets": [{"name": "dev"}],
    }),
    "docs/guide.md": "# Guide\n",
}


class CheckDocs(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.root = pathlib.Path(folder.name)
        for name, text in TREE.items():
            file = self.root / name
            file.parent.mkdir(parents=True, exist_ok=True)
            file.write_text(text)
            if name.startswith(("bin/", "scripts/")):
                file.chmod(0o755)
        self.page = self.root / "README.md"

    def check(self, text, refresh=False):
        self.page.write_text(text)
        checker = CHECK_DOCS.Checker(self.root, self.root / "bin/reisti", refresh)
        checker.check(self.page)
        return checker.findings

    def assert_accepted(self, text):
        self.assertEqual(self.check(text), [])

    def assert_refused(self, text, line, words):
        findings = self.check(text)
        self.assertEqual(len(findings), 1, findings)
        self.assertTrue(findings[0].startswith(f"README.md:{line}: "), findings[0])
        self.assertIn(words, findings[0])


class Output(CheckDocs):
    def test_what_a_command_prints_is_accepted(self):
        self.assert_accepted("```console\n$ reisti dsd\nruns: dsd\n```\n")

    def test_another_output_is_refused(self):
        self.assert_refused("```console\n$ reisti dsd\nruns: lattice\n```\n", 2, "--refresh")

    def test_missing_output_is_refused(self):
        self.assert_refused("Text.\n\n```console\n$ reisti dsd\n```\n", 4, "--refresh")

    def test_a_failing_command_is_refused(self):
        self.assert_refused("```console\n$ reistii dsd\nruns: dsd\n```\n", 2, "--refresh")

    def test_a_command_goes_on_behind_a_backslash(self):
        self.assert_accepted("```console\n$ reisti dsd \\\n    --factors 6\nruns: dsd --factors 6\n```\n")

    def test_standard_error_is_output_too(self):
        self.assert_accepted("```console\n$ echo seed 7 >&2\nseed 7\n```\n")

    def test_refreshing_writes_the_output_and_nothing_else(self):
        self.assertEqual(self.check("# A\n\n```console\n$ reisti dsd\nold\n```\nText.\n", refresh=True), [])
        self.assertEqual(self.page.read_text(), "# A\n\n```console\n$ reisti dsd\nruns: dsd\n```\nText.\n")

    def test_refreshing_keeps_the_indent_of_a_block(self):
        self.check("1. Run\n\n   ```console\n   $ reisti dsd\n   old\n   ```\n", refresh=True)
        self.assertEqual(self.page.read_text(), "1. Run\n\n   ```console\n   $ reisti dsd\n   runs: dsd\n   ```\n")

    def test_refreshing_still_tells_what_it_cannot_repair(self):
        self.assertEqual(len(self.check("```python\nprint()\n```\n", refresh=True)), 1)


class Quotes(CheckDocs):
    def test_lines_of_an_example_are_accepted(self):
        self.assert_accepted("```c\n    return des_Version();\n```\n")

    def test_lines_of_no_example_are_refused(self):
        self.assert_refused("```c\n    return des_Version() + 1;\n```\n", 2, "stands in no source file")

    def test_lines_left_out_of_a_quote_are_noticed(self):
        self.assert_refused("```c\nint main(void) {\n}\n```\n", 2, "stands in no source file")

    def test_a_build_file_is_quoted_word_for_word(self):
        self.assert_accepted("```cmake\nfind_package(reisti REQUIRED)\n```\n")
        self.assert_refused("```cmake\nfind_package(reisti)\n```\n", 2, "in no CMakeLists.txt")


    def test_a_block_that_names_a_file_is_all_of_it(self):
        self.assert_accepted(f"```c examples/host.c\n{TREE['examples/host.c']}```\n")
        self.assert_refused("```c examples/host.c\n    return des_Version();\n```\n", 2, "not the whole of")
        self.assert_refused("```c examples/guest.c\n    return des_Version();\n```\n", 2, "does not exist")

    def test_refreshing_copies_a_file(self):
        self.assertEqual(self.check("```c examples/host.c\nold\n```\n", refresh=True), [])
        self.assertEqual(self.page.read_text(), f"```c examples/host.c\n{TREE['examples/host.c']}```\n")


class UncheckedBlocks(CheckDocs):
    def test_an_unknown_language_is_refused(self):
        self.assert_refused("```python\nprint()\n```\n", 2, "\"python\" is not checked")

    def test_no_language_is_refused(self):
        self.assert_refused("```\nreisti dsd\n```\n", 2, "\"\" is not checked")

    def test_an_indented_block_is_refused(self):
        self.assert_refused("Run:\n\n    reisti dsd\n", 3, "indented")
        self.assert_refused("Run:\n\n\treisti dsd\n", 3, "indented")

    def test_an_indented_block_behind_a_fence_is_refused(self):
        self.assert_refused("```text\n.\n```\n\n    reisti dsd\n", 5, "indented")

    def test_a_continued_list_item_is_no_block(self):
        self.assert_accepted("- An item\n    that goes on\n")

    def test_tildes_are_refused(self):
        self.assert_refused("~~~\nreisti dsd\n~~~\n", 1, "three backticks")

    def test_an_open_fence_is_refused(self):
        self.assert_refused("```c\n    return des_Version();\n", 1, "three backticks")

    def test_commands_in_a_picture_are_refused(self):
        self.assert_refused("```text\n$ reisti dsd\n```\n", 2, "```console")

    def test_a_picture_names_existing_functions(self):
        self.assert_accepted("```text\nhost -> des_Version()\n```\n")
        self.assert_refused("```text\nhost -> des_Verse()\n```\n", 2, "des_Verse is not in the public header")


class Commands(CheckDocs):
    def assert_shell_refused(self, command, words):
        self.assert_refused(f"```sh\n{command}\n```\n", 2, words)

    def test_commands_that_name_what_exists_are_accepted(self):
        for command in ("scripts/demo", "scripts/demo --quick", "cmake --workflow --preset dev",
                        "cmake --preset dev -DREISTI_DEVELOPER=ON && cmake --build --preset dev --target unit_dsd",
                        "cmake --build --preset dev --target unit_dsd unit_dsd -j 2", "cmake -S examples -B build/examples", "ctest --preset dev -R RowCount", "ctest --preset dev -R '^CHost'",
                        "build/dev/tests/unit/dsd/unit_dsd --gtest_filter='RowCount.*'",
                        "build/dev/fuzz/rows_fuzzer", "gdb --args build/dev/tests/unit/dsd/unit_dsd"):
            with self.subTest(command):
                self.assert_accepted(f"```sh\n{command}\n```\n")

    def test_a_line_of_an_install_test_is_accepted(self):
        self.assert_accepted("```sh\ncc -std=c99 host.c -lreisti\n```\n")

    def test_commands_that_name_what_does_not_exist_are_refused(self):
        for command, words in (("scripts/demos", "no such script"), ("scripts/demo --slow", "does not know --slow"),
                               ("cmake --preset base", "no such preset"), ("ctest --preset release", "no such preset"),
                               ("cmake --build --preset dev --target unit_dsd unit", "no such target: unit"),
                               ("cmake --preset dev -DREISTI_DEV=ON", "no such setting"),
                               ("cmake --preset dev --trace", "not known"),
                               ("cmake -S samples -B build/samples", "no CMakeLists.txt"),
                               ("ctest --preset dev -R Rows", "no test matches"),
                               ("build/dev/tests/unit/unit_dsd", "no such program"),
                               ("build/dev/fuzz/lines_fuzzer", "no such program"),
                               ("build/dev/tests/unit/dsd/unit_dsd --gtest_filter='Rows.*'", "no test matches"),
                               ("scripts/demo && make", "make is not known"), ("echo 'open", "No closing quotation")):
            with self.subTest(command):
                self.assert_shell_refused(command, words)

    def test_a_script_has_to_be_executable(self):
        (self.root / "scripts/demo").chmod(0o644)
        self.assert_shell_refused("scripts/demo", "no such script")

    def test_commands_within_a_sentence_are_checked_too(self):
        self.assert_accepted("Run `scripts/demo --quick`, then `ctest --preset dev -R RowCount`.\n")
        self.assert_refused("# A\n\nRun `scripts/demos`.\n", 3, "no such script")


class Sentences(CheckDocs):
    def test_links_lead_somewhere(self):
        self.assert_accepted("[guide](docs/guide.md), [part](docs/guide.md#limits), [site](https://example.org/x)\n")
        self.assert_refused("See\n\nthe [guide](docs/guides.md).\n", 3, "leads nowhere")

    def test_paths_exist(self):
        self.assert_accepted("`examples/host.c` and `examples/`, read/write, `and/or`\n")
        (self.root / "scripts/list.txt").touch()
        self.assert_accepted("`scripts/list.txt`\n")
        self.assert_refused("`examples/host.cpp`\n", 1, "does not exist")

    def test_functions_exist(self):
        self.assert_accepted("`des_Version`, all of `des_...`\n")
        self.assert_refused("des_Versions\n", 1, "not in the public header")

    def test_names_exist(self):
        self.assert_accepted("`numFactors`, `lib::numFactors`, `std_order`, `vertices`, `q`, `Debian 12`\n")
        self.assert_refused("`numFactor`\n", 1, "nothing is called numFactor")
        self.assert_refused("| `lib::factors` |\n", 1, "nothing is called lib::factors")

    def test_tests_exist(self):
        self.assert_accepted("`RowCount.OfSixFactorsIsThirteen`, `CHost.Builds`, `std.map`\n")
        self.assert_refused("`RowCount.OfSevenFactors`\n", 1, "no test RowCount.OfSevenFactors")

    def test_options_and_commands_of_the_program_exist(self):
        self.assert_accepted("`reisti dsd --factors 6`, `reisti COMMAND --help`, `--quick`, `--factors`\n")
        self.assert_refused("`reisti dds`\n", 1, "no command dds")
        self.assert_refused("`--factor`\n", 1, "an option of nothing")

    def test_a_span_may_go_on_in_the_next_line(self):
        self.assert_refused("Run `reisti\ndds` now, and `b` too.\n", 1, "no command dds")


if __name__ == "__main__":
    unittest.main()
