// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import com.sun.jna.Memory;
import com.sun.jna.Native;
import com.sun.jna.Pointer;
import com.sun.jna.ptr.IntByReference;
import java.io.IOException;
import java.util.HashMap;
import java.util.List;
import java.util.Map;
import java.util.Objects;
import java.util.concurrent.ConcurrentLinkedQueue;
import java.util.function.Consumer;

/**
 * A connection to the desktop's message bus, D-Bus. Everything happens on the thread that runs it,
 * to which others hand over what they want done.
 */
final class Bus {
    /** What answers calls. */
    interface Service {
        /** Gives the values of the answer, or null for a method that it does not have. */
        List<?> answer(String type, String method, List<Object> values);
    }

    // How long what was handed over may wait.
    private static final int LOOK_MS = 200;

    private static final String NO_METHOD = "org.freedesktop.DBus.Error.UnknownMethod";

    private final LibDbus dbus = LibDbus.load();
    private final Values values = new Values(dbus);
    private final Pointer connection;
    private final ConcurrentLinkedQueue<Runnable> tasks = new ConcurrentLinkedQueue<>();
    private final Map<Integer, Consumer<List<Object>>> replies = new HashMap<>();
    private volatile boolean isClosing;

    /** Connects to the bus at that address; blocks. */
    Bus(String address) throws IOException {
        Pointer error = new Memory(LibDbus.ERROR_BYTES);
        dbus.dbus_error_init(error);
        connection = dbus.dbus_connection_open_private(address, error);
        check(connection != null, error);
        dbus.dbus_connection_set_exit_on_disconnect(connection, 0);
        if (dbus.dbus_bus_register(connection, error) == 0) {
            release();
            check(false, error);
        }
    }

    private void check(boolean done, Pointer error) throws IOException {
        if (!done) {
            Pointer text = error.getPointer(Native.POINTER_SIZE);
            String message = text == null ? "no connection" : text.getString(0);
            dbus.dbus_error_free(error);
            throw new IOException(message);
        }
    }

    /** Takes a name, by which others find it; false when another program has it. */
    boolean takeName(String name) {
        return dbus.dbus_bus_request_name(connection, name, LibDbus.DO_NOT_QUEUE, null)
                == LibDbus.PRIMARY_OWNER;
    }

    /** Answers calls until it is closed or the bus goes away; then the connection is gone. */
    void run(Service service) {
        try {
            while (!isClosing && dbus.dbus_connection_read_write(connection, LOOK_MS) != 0) {
                takeMessages(service);
                runTasks();
            }
            runTasks(); // What was still wanted.
            dbus.dbus_connection_flush(connection);
        } finally {
            release();
        }
    }

    private void runTasks() {
        for (Runnable task; (task = tasks.poll()) != null; ) {
            task.run();
        }
    }

    private void takeMessages(Service service) {
        for (Pointer message; (message = dbus.dbus_connection_pop_message(connection)) != null; ) {
            try {
                take(message, service);
            } finally {
                dbus.dbus_message_unref(message);
            }
        }
    }

    private void take(Pointer message, Service service) {
        switch (dbus.dbus_message_get_type(message)) {
            case LibDbus.CALL -> answer(message, service);
            case LibDbus.REPLY -> {
                var then = replies.remove(dbus.dbus_message_get_reply_serial(message));
                if (then != null) {
                    then.accept(values.read(message));
                }
            }
            case LibDbus.ERROR -> replies.remove(dbus.dbus_message_get_reply_serial(message));
            default -> { }
        }
    }

    private void answer(Pointer call, Service service) {
        String type = Objects.requireNonNullElse(dbus.dbus_message_get_interface(call), "");
        String method = dbus.dbus_message_get_member(call);
        List<?> answer = service.answer(type, method, values.read(call));
        if (dbus.dbus_message_get_no_reply(call) != 0) {
            return;
        }
        if (answer == null) {
            String text = "There is no such method";
            send(dbus.dbus_message_new_error(call, NO_METHOD, text), List.of());
        } else {
            send(dbus.dbus_message_new_method_return(call), answer);
        }
    }

    /** Has this run by the bus's thread within a moment. Any thread. */
    void later(Runnable task) {
        tasks.add(task);
    }

    /** Ends the run within a moment. Any thread. */
    void close() {
        isClosing = true;
    }

    /** On the bus's thread. */
    void signal(String path, String type, String name, Object... arguments) {
        send(dbus.dbus_message_new_signal(path, type, name), List.of(arguments));
    }

    /** On the bus's thread; then is called there with the answer, and never if there is none. */
    void call(Address to, String method, List<?> arguments, Consumer<List<Object>> then) {
        Pointer message =
                dbus.dbus_message_new_method_call(to.name(), to.path(), to.type(), method);
        replies.put(send(message, arguments), then);
    }

    /** An object of another program. */
    record Address(String name, String path, String type) {}

    private int send(Pointer message, List<?> arguments) {
        values.append(message, arguments);
        IntByReference serial = new IntByReference();
        dbus.dbus_connection_send(connection, message, serial);
        dbus.dbus_message_unref(message);
        return serial.getValue();
    }

    private void release() {
        dbus.dbus_connection_close(connection);
        dbus.dbus_connection_unref(connection);
    }
}
