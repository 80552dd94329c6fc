# SPDX-License-Identifier: Apache-2.0
"""What a build file of the platform's form says of its one module."""

import re


def strings_of(text, name):
    """The strings of the module's list of that name."""
    found = re.search(rf"^    {name}: \[(.*?)\]", text, re.MULTILINE | re.DOTALL)
    return re.findall(r'"([^"]*)"', found.group(1))


def string_of(text, name):
    return re.search(rf'^    {name}: "(.*)",$', text, re.MULTILINE).group(1)
