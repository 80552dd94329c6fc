# SPDX-License-Identifier: Apache-2.0
"""The table for people, and the same for programs."""

import json
import textwrap
import xml.etree.ElementTree as ElementTree

from runner import FAIL, NOT_OFFERED, PASS

WIDTH = 100
MARGIN = 15


def lines_of(outcome):
    """A row's result and test; below it the sentence and, unless it passed, why."""
    lines = [f"  {outcome.result:<{MARGIN - 4}}  {outcome.row.test}"]
    lines += textwrap.wrap(outcome.row.sentence, WIDTH, initial_indent=" " * MARGIN,
                           subsequent_indent=" " * MARGIN)
    return lines + [" " * MARGIN + "| " + line for line in outcome.said if line.strip()]


def total(outcomes):
    results = [outcome.result for outcome in outcomes]
    return (f"{len(results)} rows: {results.count(PASS)} pass, {results.count(FAIL)} fail, "
            f"{results.count(NOT_OFFERED)} not offered")


def print_table(outcomes):
    """As the outcomes come; returns them as a list."""
    kept = []
    for outcome in outcomes:
        if not kept or kept[-1].row.operation != outcome.row.operation:
            print(outcome.row.operation)
        print("\n".join(lines_of(outcome)), flush=True)
        kept.append(outcome)
    print(total(kept))
    return kept


def write_json(path, engine, outcomes):
    rows = [{"test": outcome.row.test, "operation": outcome.row.operation,
             "sentence": outcome.row.sentence, "result": outcome.result.lower(),
             "said": outcome.said} for outcome in outcomes]
    with open(path, "w", encoding="utf-8") as file:
        json.dump({"engine": engine, "rows": rows}, file, indent=2, ensure_ascii=False)
        file.write("\n")


def write_junit(path, engine, outcomes):
    results = [outcome.result for outcome in outcomes]
    suite = ElementTree.Element("testsuite", name=engine, tests=str(len(results)),
                                failures=str(results.count(FAIL)),
                                skipped=str(results.count(NOT_OFFERED)))
    for outcome in outcomes:
        case = ElementTree.SubElement(suite, "testcase", classname=outcome.row.operation,
                                      name=outcome.row.test)
        if outcome.result != PASS:
            kind = "failure" if outcome.result == FAIL else "skipped"
            element = ElementTree.SubElement(case, kind, message=outcome.row.sentence)
            element.text = "\n".join(map(printable, outcome.said))
    ElementTree.ElementTree(suite).write(path, encoding="utf-8", xml_declaration=True)


def printable(line):
    """XML has no control characters."""
    return "".join(letter if letter.isprintable() else "?" for letter in line)
