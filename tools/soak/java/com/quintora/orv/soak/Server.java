// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.BufferedReader;
import java.io.Closeable;
import java.io.IOException;
import java.io.InputStreamReader;
import java.io.OutputStream;
import java.net.InetAddress;
import java.net.ServerSocket;
import java.net.Socket;
import java.nio.charset.StandardCharsets;
import java.util.HashSet;
import java.util.Set;
import java.util.regex.Matcher;
import java.util.regex.Pattern;

/** A server of one file over HTTP 1.1, a request for each connection. */
final class Server implements Closeable {
    /** How it treats who asks. */
    enum Manner {
        ANSWERS("answers"),
        REFUSES("refuses"),
        CUTS("sends less than it announces"),
        BREAKS("breaks connections"),
        STALLS("falls silent for good");

        final String words;

        Manner(String words) {
            this.words = words;
        }
    }

    private static final Pattern RANGE = Pattern.compile("(?i)range: bytes=(\\d+)-.*");
    private static final int[] STATUSES = {403, 404, 500, 503};

    private final Manner manner;
    private final byte[] bytes;
    private final double part;
    private final ServerSocket listener;
    private final Set<Socket> open = new HashSet<>();
    private boolean closed;
    private volatile boolean silent;

    /** Where it cuts or stalls is that part of what it sends, 0 to 1. */
    Server(Manner manner, byte[] bytes, double part) throws IOException {
        this.manner = manner;
        this.bytes = bytes;
        this.part = part;
        listener = new ServerSocket(0, 50, InetAddress.getLoopbackAddress());
        begin(this::listen);
    }

    String url() {
        return "http://127.0.0.1:" + listener.getLocalPort() + "/media";
    }

    boolean stalls() {
        return manner == Manner.STALLS;
    }

    /** Ends it and all its connections. */
    @Override
    public void close() {
        synchronized (this) {
            closed = true;
            open.forEach(Server::closeQuietly);
            open.clear();
        }
        closeQuietly(listener);
    }

    private void listen() {
        while (true) {
            try {
                Socket socket = listener.accept();
                if (!keep(socket)) {
                    return;
                }
                begin(() -> serve(socket));
            } catch (IOException e) {
                return; // It was closed.
            }
        }
    }

    private synchronized boolean keep(Socket socket) {
        if (closed) {
            closeQuietly(socket);
            return false;
        }
        return open.add(socket);
    }

    private void serve(Socket socket) {
        try (socket) {
            answer(socket, firstByteAsked(socket));
        } catch (IOException e) {
            return; // The player has read enough, or the server was closed.
        } finally {
            synchronized (this) {
                open.remove(socket);
            }
        }
    }

    /** -1 without a range. */
    private static long firstByteAsked(Socket socket) throws IOException {
        BufferedReader request = new BufferedReader(
                new InputStreamReader(socket.getInputStream(), StandardCharsets.US_ASCII));
        long first = -1;
        String line = request.readLine();
        while (line != null && !line.isEmpty()) {
            Matcher range = RANGE.matcher(line);
            first = range.matches() ? Long.parseLong(range.group(1)) : first;
            line = request.readLine();
        }
        return first;
    }

    private void answer(Socket socket, long asked) throws IOException {
        OutputStream out = socket.getOutputStream();
        if (manner == Manner.REFUSES) {
            int status = STATUSES[(int) (part * STATUSES.length)];
            send(out, status + " No", "Content-Length: 0");
            return;
        }
        if (silent) {
            awaitClose(socket);
            return;
        }
        boolean knowsRanges = manner != Manner.CUTS;
        int from = knowsRanges ? (int) Math.min(Math.max(asked, 0), bytes.length) : 0;
        int length = bytes.length - from;
        if (knowsRanges && asked >= 0) {
            send(out, "206 Partial", "Accept-Ranges: bytes", "Content-Length: " + length,
                    "Content-Range: bytes " + from + "-" + (bytes.length - 1) + "/" + bytes.length);
        } else {
            send(out, "200 OK", knowsRanges ? "Accept-Ranges: bytes" : "Accept-Ranges: none",
                    "Content-Length: " + length);
        }
        out.write(bytes, from, sent(length));
        if (manner == Manner.STALLS) {
            out.flush();
            silent = true;
            awaitClose(socket);
        }
    }

    /** Says nothing until one side closes. */
    private static void awaitClose(Socket socket) throws IOException {
        if (socket.getInputStream().read() >= 0) {
            throw new IOException("a request was sent twice");
        }
    }

    private int sent(int length) {
        return switch (manner) {
            case ANSWERS, REFUSES -> length;
            case CUTS -> (int) (length * (0.02 + 0.2 * part));
            case BREAKS, STALLS -> (int) (length * (0.1 + 0.8 * part));
        };
    }

    private static void send(OutputStream out, String status, String... headers)
            throws IOException {
        out.write(("HTTP/1.1 " + status + "\r\nConnection: close\r\n"
                + String.join("\r\n", headers) + "\r\n\r\n").getBytes(StandardCharsets.US_ASCII));
    }

    private static void begin(Runnable task) {
        Thread thread = new Thread(task, "soak-server");
        thread.setDaemon(true);
        thread.start();
    }

    private static void closeQuietly(Closeable closeable) {
        try {
            closeable.close();
        } catch (IOException e) {
            return; // It is given up in any case.
        }
    }
}
