#!/usr/bin/env python3
"""usage: tools/golden_linear_algebra.py LINEAR_ALGEBRA_JSON OUTPUT_DIRECTORY

Turns the collection of published matrices into one plain text file per matrix, the form that the golden tests read.
"""

import json
import sys
from pathlib import Path

CHOLESKY_TOLERANCE = "1e-12"
EIGENVALUE_TOLERANCE = "1e-12"


def rows(matrix):
    return "".join(" ".join(repr(float(cell)) for cell in row) + "\n" for row in matrix)


def text_of(case):
    expected = case["expected"]
    lines = [
        f"# {case['id']}: a published matrix with its exact determinant, inverse and spectrum",
        f"# source: {case['source']}",
        "# tolerance: determinant relative_tolerance; inverse relative_tolerance times its largest element;",
        f"#   eigenvalues {EIGENVALUE_TOLERANCE} times the largest magnitude; Cholesky factor {CHOLESKY_TOLERANCE} relative",
        "# refresh: tools/golden_linear_algebra.py LINEAR_ALGEBRA_JSON tests/golden/matrix",
    ]
    if "determinant" in case.get("published", {}):
        lines.append(f"# printed there: determinant {case['published']['determinant']!r}")
    if "note" in case:
        lines.append(f"# note: {case['note']}")
    out = "\n".join(lines) + "\n"
    out += f"order {case['order']}\nentries\n" + rows(case["entries"])
    out += f"determinant {float(expected['determinant'])!r}\n"
    out += f"lu_succeeds {'yes' if expected['lu_succeeds'] else 'no'}\n"
    if "relative_tolerance" in expected:
        out += f"relative_tolerance {expected['relative_tolerance']!r}\n"
    if "cholesky_failed_row" in expected:
        out += f"cholesky_failed_row {expected['cholesky_failed_row']}\n"
    if "cholesky_upper" in expected:
        out += "cholesky_upper\n" + rows(expected["cholesky_upper"])
    if "inverse" in expected:
        out += "inverse\n" + rows(expected["inverse"])
    if "eigenvalues_ascending" in expected:
        out += "eigenvalues\n" + " ".join(str(value) for value in expected["eigenvalues_ascending"]) + "\n"
    return out


def main():
    if len(sys.argv) != 3:
        sys.exit(__doc__)
    cases = json.loads(Path(sys.argv[1]).read_text(encoding="utf-8"))["cases"]
    for case in cases:
        (Path(sys.argv[2]) / f"{case['id']}.txt").write_text(text_of(case), encoding="utf-8")
    print(f"{len(cases)} files written")


if __name__ == "__main__":
    main()
