// SPDX-License-Identifier: Apache-2.0

/** Characters from start to end, and what they become. */
record Change(String function, String operator, int start, int end, int firstLine, int lastLine,
        String becomes) {}
