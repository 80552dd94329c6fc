# SPDX-License-Identifier: Apache-2.0
"""The rows of the table: the tests of tests/engine-kit, and what each cites."""

import collections
import re

from contract import Contract, Mismatch

FOLDER = "tests/engine-kit"
# test: its name to GoogleTest; sentence: the header's.
Row = collections.namedtuple("Row", "test operation sentence")

TEST = re.compile(r'^TEST_F\((\w+), (\w+)\) \{(?:\s*checks\("([^"]*)",((?:\s*"[^"]*")+)\);)?',
                  re.MULTILINE)


def read(root):
    """All rows, in the order of the header's operations."""
    contract, found = Contract(root), []
    for file in sorted((root / FOLDER).glob("*Test.cpp")):
        for suite, name, operation, words in TEST.findall(file.read_text(encoding="utf-8")):
            test = f"{suite}.{name}"
            if not operation:
                raise Mismatch(f"{test} does not say first what it checks")
            words = "".join(re.findall(r'"([^"]*)"', words))
            found.append(Row(test, contract.key_of(operation),
                             contract.sentence(operation, words)))
    order = contract.keys()
    return sorted(found, key=lambda row: order.index(row.operation))


def without_row(root):
    """Operations without a row, and those whose own sentences no row cites."""
    contract, rows = Contract(root), read(root)
    cited = collections.defaultdict(set)
    for row in rows:
        cited[row.operation].add(row.sentence)
    return [key for key, operation in contract.operations.items()
            if not cited[key] or operation.own and not cited[key] & set(operation.own)]
