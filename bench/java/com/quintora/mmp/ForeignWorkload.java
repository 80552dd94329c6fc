// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.lang.invoke.MethodHandle;
import java.lang.reflect.Array;

/**
 * Calls a C function by the foreign-function interface of Java 22. By way of reflection until it
 * has its handle, for older compilers do not know that interface; the calls themselves are plain.
 */
final class ForeignWorkload extends Workload {
    private static final MethodHandle NOTHING = at(Long.getLong("orv.bench.nothing"));

    private static MethodHandle at(long address) {
        try {
            Class<?> linker = foreign("Linker");
            Class<?> option = foreign("Linker$Option");
            Class<?> descriptor = foreign("FunctionDescriptor");
            Class<?> layout = foreign("MemoryLayout");
            Class<?> segment = foreign("MemorySegment");
            Object returnsInt =
                    descriptor.getMethod("of", layout, layout.arrayType())
                            .invoke(null, foreign("ValueLayout").getField("JAVA_INT").get(null),
                                    Array.newInstance(layout, 0));
            return (MethodHandle)
                    linker.getMethod("downcallHandle", segment, descriptor, option.arrayType())
                            .invoke(linker.getMethod("nativeLinker").invoke(null),
                                    segment.getMethod("ofAddress", long.class).invoke(null, address),
                                    returnsInt, Array.newInstance(option, 0));
        } catch (ReflectiveOperationException e) {
            throw new IllegalStateException("this Java has no foreign-function interface", e);
        }
    }

    private static Class<?> foreign(String name) throws ClassNotFoundException {
        return Class.forName("java.lang.foreign." + name);
    }

    private int sum;

    @Override
    void run(int times) {
        try {
            for (int i = 0; i < times; i++) {
                sum += (int) NOTHING.invokeExact();
            }
        } catch (Throwable e) {
            throw new IllegalStateException(e);
        }
    }
}
