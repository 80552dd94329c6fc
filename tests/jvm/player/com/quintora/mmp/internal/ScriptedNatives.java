// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.SharedFields;
import java.lang.reflect.InvocationHandler;
import java.lang.reflect.Proxy;
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

    public final List<String> calls = new CopyOnWriteArrayList<>();
    private final Map<String, Callable<Object>> answers = new ConcurrentHashMap<>();

    /** What a call of that name does and returns from now on. */
    public void answer(String name, Callable<Object> answer) {
        answers.put(name, answer);
    }

    /** A player of these natives, whose listeners are called at once. */
    public PlayerUnits units() {
        InvocationHandler handler = (proxy, method, arguments) -> {
            calls.add(method.getName());
            Callable<Object> answer = answers.get(method.getName());
            return answer != null ? answer.call() : zero(method.getReturnType());
        };
        ClassLoader loader = ScriptedNatives.class.getClassLoader();
        Natives natives = (Natives)
                Proxy.newProxyInstance(loader, new Class<?>[] {Natives.class}, handler);
        MediaPlayer player = (MediaPlayer) Proxy.newProxyInstance(
                loader, new Class<?>[] {MediaPlayer.class}, (proxy, method, arguments) -> null);
        return new PlayerUnits(player, natives, Runnable::run);
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
