// SPDX-License-Identifier: Apache-2.0
import java.util.List;
import java.util.Map;

/** What a piece of Java source becomes. */
final class Operators {
    private static final Map<String, String> RELATIONAL = Map.of(
            "<", "<=", "<=", "<", ">", ">=", ">=", ">", "==", "!=", "!=", "==");
    private static final Map<String, String> LOGICAL = Map.of("&&", "||", "||", "&&");
    private static final Map<String, String> ARITHMETIC = Map.ofEntries(
            Map.entry("+", "-"), Map.entry("-", "+"), Map.entry("*", "/"), Map.entry("/", "*"),
            Map.entry("%", "*"), Map.entry("<<", ">>"), Map.entry(">>", "<<"),
            Map.entry(">>>", "<<"), Map.entry("&", "|"), Map.entry("|", "&"),
            Map.entry("^", "&"), Map.entry("+=", "-="), Map.entry("-=", "+="),
            Map.entry("*=", "/="), Map.entry("/=", "*="), Map.entry("%=", "*="),
            Map.entry("&=", "|="), Map.entry("|=", "&="), Map.entry("^=", "&="),
            Map.entry("<<=", ">>="), Map.entry(">>=", "<<="), Map.entry("++", "--"),
            Map.entry("--", "++"));

    private Operators() {}

    /** The operator's name and what becomes of the symbol; null for another symbol. */
    static String[] symbol(String symbol) {
        if (RELATIONAL.containsKey(symbol)) {
            return new String[] {"relational", RELATIONAL.get(symbol)};
        }
        if (LOGICAL.containsKey(symbol)) {
            return new String[] {"logical", LOGICAL.get(symbol)};
        }
        String becomes = ARITHMETIC.get(symbol);
        return becomes == null ? null : new String[] {"arithmetic", becomes};
    }

    /** 0 and 1 change places, other numbers move by one. */
    static List<String> constants(String literal, Object value) {
        if (value instanceof Boolean is) {
            return List.of(is ? "false" : "true");
        }
        if (value instanceof Integer || value instanceof Long) {
            long number = ((Number) value).longValue();
            String suffix = value instanceof Long ? "L" : "";
            if (number == 0 || number == 1) {
                return List.of((1 - number) + suffix);
            }
            return List.of("(" + literal + " + 1" + suffix + ")",
                    "(" + literal + " - 1" + suffix + ")");
        }
        return value instanceof Float || value instanceof Double
                ? List.of("(" + literal + " + 1)") : List.of();
    }

    /** What is returned in an expression's place by a method of that type. */
    static List<String> returned(String expression, String type) {
        boolean isLiteral = expression.matches("true|false|null|-?[0-9.]+[fFdDlL]?|\"\"");
        if (isLiteral || type.equals("void")) {
            return List.of();
        }
        return switch (type) {
            case "boolean" -> List.of("!(" + expression + ")");
            case "int", "long", "short", "byte", "float", "double", "char" ->
                expression.matches("[A-Z][A-Z0-9_]*") ? List.of("(" + expression + ") + 1")
                        : List.of("0");
            default -> List.of("null");
        };
    }
}
