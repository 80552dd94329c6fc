// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.SharedFields;
import java.lang.reflect.InvocationHandler;
import java.lang.reflect.Proxy;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.concurrent.Callable;
import java.util.concurrent.ConcurrentHashMap;
import java.util.concurrent.CopyOnWriteArrayList;

/**
 * Stands in for the native half: notes its calls and answers as scripted, otherwise with 0 and
 * false.
 */
public final class ScriptedNatives {
    /** What the units know of the native half. */
    public interface Natives extends NativePlayer, SharedFields {}

    /** The names of the calls. */
    public final List<String> calls = new CopyOnWriteArrayList<>();

    /** The calls with their arguments, as in "setVolume[0.5, 1.0]". */
    public final List<String> lines = new CopyOnWriteArrayList<>();

    private final Map<String, Callable<Object>> answers = new ConcurrentHashMap<>();

    private final Natives natives = (Natives) Proxy.newProxyInstance(
            ScriptedNatives.class.getClassLoader(), new Class<?>[] {Natives.class}, handler());

    /** What a call of that name does and returns from now on. */
    public void answer(String name, Callable<Object> answer) {
        answers.put(name, answer);
    }

    /** What the units call. */
    public Natives natives() {
        return natives;
    }

    /** A player of these natives, whose listeners are called at once. */
    public PlayerUnits units() {
        MediaPlayer player = (MediaPlayer) Proxy.newProxyInstance(
                ScriptedNatives.class.getClassLoader(), new Class<?>[] {MediaPlayer.class},
                (proxy, method, arguments) -> null);
        return new PlayerUnits(player, natives, Runnable::run);
    }

    private InvocationHandler handler() {
        return (proxy, method, arguments) -> {
            calls.add(method.getName());
            lines.add(method.getName()
                    + Arrays.toString(arguments == null ? new Object[0] : arguments));
            Callable<Object> answer = answers.get(method.getName());
            return answer != null ? answer.call() : zero(method.getReturnType());
        };
    }

    /** How often it was called so. */
    public long count(String name) {
        return calls.stream().filter(name::equals).count();
    }

    private static Object zero(Class<?> type) {
        if (type == boolean.class) {
            return false;
        }
        return type == int.class ? (Object) 0 : null;
    }
}
