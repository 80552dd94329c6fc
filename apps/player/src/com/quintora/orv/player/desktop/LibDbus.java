// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import com.sun.jna.Library;
import com.sun.jna.Native;
import com.sun.jna.Pointer;
import com.sun.jna.ptr.IntByReference;

/** The reference implementation of D-Bus, libdbus-1, as its header declares it. */
@SuppressWarnings("checkstyle:MethodName") // The names are the library's.
interface LibDbus extends Library {
    int CALL = 1;
    int REPLY = 2;
    int ERROR = 3;

    int DO_NOT_QUEUE = 4;
    int PRIMARY_OWNER = 1;

    /** Bytes that are enough for a DBusError and for a DBusMessageIter. */
    int ERROR_BYTES = 64;

    int ITER_BYTES = 256;

    /** Loads the library; UnsatisfiedLinkError when there is none. */
    static LibDbus load() {
        return Native.load("dbus-1", LibDbus.class);
    }

    void dbus_error_init(Pointer error);

    void dbus_error_free(Pointer error);

    Pointer dbus_connection_open_private(String address, Pointer error);

    int dbus_bus_register(Pointer connection, Pointer error);

    int dbus_bus_request_name(Pointer connection, String name, int flags, Pointer error);

    void dbus_connection_set_exit_on_disconnect(Pointer connection, int exits);

    int dbus_connection_read_write(Pointer connection, int timeoutMs);

    Pointer dbus_connection_pop_message(Pointer connection);

    int dbus_connection_send(Pointer connection, Pointer message, IntByReference serial);

    void dbus_connection_flush(Pointer connection);

    void dbus_connection_close(Pointer connection);

    void dbus_connection_unref(Pointer connection);

    Pointer dbus_message_new_method_call(
            String destination, String path, String type, String method);

    Pointer dbus_message_new_method_return(Pointer call);

    Pointer dbus_message_new_error(Pointer call, String name, String text);

    Pointer dbus_message_new_signal(String path, String type, String name);

    void dbus_message_unref(Pointer message);

    int dbus_message_get_type(Pointer message);

    int dbus_message_get_reply_serial(Pointer message);

    int dbus_message_get_no_reply(Pointer message);

    String dbus_message_get_interface(Pointer message);

    String dbus_message_get_member(Pointer message);

    int dbus_message_iter_init(Pointer message, Pointer iter);

    int dbus_message_iter_get_arg_type(Pointer iter);

    void dbus_message_iter_get_basic(Pointer iter, Pointer value);

    void dbus_message_iter_recurse(Pointer iter, Pointer inner);

    int dbus_message_iter_next(Pointer iter);

    void dbus_message_iter_init_append(Pointer message, Pointer iter);

    int dbus_message_iter_append_basic(Pointer iter, int type, Pointer value);

    int dbus_message_iter_open_container(
            Pointer iter, int type, String signature, Pointer inner);

    int dbus_message_iter_close_container(Pointer iter, Pointer inner);
}
