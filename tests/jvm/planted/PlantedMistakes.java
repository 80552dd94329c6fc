// SPDX-License-Identifier: Apache-2.0

/** Calls the native methods that its arguments name, some of which are mistaken on purpose. */
final class PlantedMistakes {
    private PlantedMistakes() {}

    private static native void keepReferences();

    private static native void deleteReferences();

    private static native void callUnchecked();

    private static native void callChecked();

    private static void nothing() {}

    public static void main(String[] names) throws Exception {
        System.loadLibrary("orv_planted_mistakes");
        for (String name : names) {
            PlantedMistakes.class.getDeclaredMethod(name).invoke(null);
        }
    }
}
