"""What scripts/check-functions finds and misses, on a small tree."""
import pathlib
import tempfile
import unittest

from loading import load

CHECK_FUNCTIONS = load("check-functions")

TREE = {
    "abi/exports.txt": "des_RunSimplexCentroidDesign\ndes_Version\n",
    "tests/unit/capi/version_test.cpp": "EXPECT_STREQ(des_Version(), x);\n",
    "tests/unit/mixture/centroid_test.cpp": "const auto request = centroidRequest(3);\n",
    "tests/support/mixture_record.cpp": "return des_RunSimplexCentroidDesign(design_);\n",
    "tests/capi/host.c": "des_Version(); run(des_RunSimplexCentroidDesign);\n",
    "fuzz/simplex_centroid_fuzzer.cpp": "#include \"mixture_call.h\"\n",
    "fuzz/mixture_call.h": "",
    "fuzz/mixture_call.cpp": "des_RunSimplexCentroidDesign(design);\n",
    "bench/mixture/simplex_bench.cpp": "des_RunSimplexCentroidDesign(design);\n",
    "examples/host.c": "des_RunSimplexCentroidDesign(design); des_Version();\n",
    "packaging/man/reisti.3": ".Fn des_Version\n.Fn des_RunSimplexCentroidDesign\n",
}
REASONS = {("fuzzer", "des_Version"): "takes no input", ("benchmark", "des_Version"): "returns a constant"}


class CheckFunctions(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.root = pathlib.Path(folder.name)
        for name, text in TREE.items():
            self.write(name, text)
        self.addCleanup(setattr, CHECK_FUNCTIONS, "EXCEPTIONS", CHECK_FUNCTIONS.EXCEPTIONS)
        CHECK_FUNCTIONS.EXCEPTIONS = REASONS

    def write(self, name, text):
        file = self.root / name
        file.parent.mkdir(parents=True, exist_ok=True)
        file.write_text(text)

    def page(self):
        findings = []
        return CHECK_FUNCTIONS.page(CHECK_FUNCTIONS.Tree(self.root), findings), findings

    def assert_missing(self, words):
        page, findings = self.page()
        self.assertEqual(len(findings), 1, findings)
        self.assertIn(words, findings[0])
        self.assertIn("**none**", page)

    def test_every_cell_names_a_file_or_a_reason(self):
        page, findings = self.page()
        self.assertEqual(findings, [])
        row = next(line for line in page.splitlines() if "des_Version" in line)
        self.assertEqual(row, "| `des_Version` | [version_test.cpp](../tests/unit/capi/version_test.cpp) "
                              "| [host.c](../tests/capi/host.c) | none: takes no input | none: returns a constant "
                              "| [host.c](../examples/host.c) | [reisti.3](../packaging/man/reisti.3) |")

    def test_a_fixture_counts_where_a_test_uses_it(self):
        self.assertIn("[centroid_test.cpp]", self.page()[0])
        self.write("tests/support/mixture_record.cpp", "")
        self.assert_missing("des_RunSimplexCentroidDesign has no unit test")

    def test_a_helper_counts_where_a_fuzzer_includes_it(self):
        self.assertIn("[simplex_centroid_fuzzer.cpp]", self.page()[0])
        self.write("fuzz/simplex_centroid_fuzzer.cpp", "")
        self.assert_missing("des_RunSimplexCentroidDesign has no fuzzer")

    def test_a_comment_is_no_call(self):
        self.write("bench/mixture/simplex_bench.cpp", "// des_RunSimplexCentroidDesign()\n/* des_RunSimplexCentroidDesign */")
        self.assert_missing("des_RunSimplexCentroidDesign has no benchmark")

    def test_a_longer_name_is_no_call(self):
        self.write("examples/host.c", "des_RunSimplexCentroidDesign(design); des_VersionNumber();\n")
        self.assert_missing("des_Version has no example")

    def test_a_manual_page_has_to_describe_the_function(self):
        self.write("packaging/man/reisti.3", ".Fn des_RunSimplexCentroidDesign\nSee des_Version.\n")
        self.assert_missing("des_Version has no manual page")

    def test_the_file_is_named_whose_name_is_closest(self):
        self.write("fuzz/any_fuzzer.cpp", "#include \"mixture_call.h\"\n")
        self.assertIn("[simplex_centroid_fuzzer.cpp]", self.page()[0])

    def test_a_reason_for_nothing_is_told(self):
        self.write("abi/exports.txt", "des_RunSimplexCentroidDesign\n")
        self.assertTrue(all("not exported" in finding for finding in self.page()[1]))
        self.assertEqual(len(self.page()[1]), 2)


if __name__ == "__main__":
    unittest.main()
