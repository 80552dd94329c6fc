// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.sun.net.httpserver.HttpExchange;
import com.sun.net.httpserver.HttpServer;
import java.io.IOException;
import java.io.InterruptedIOException;
import java.net.InetAddress;
import java.net.InetSocketAddress;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;

/**
 * A server on this machine that sends a file only up to a place, and the rest on demand.
 * The index at the file's end comes at once. It knows byte ranges.
 */
public final class StallingServer implements AutoCloseable {
    private static final double INDEX_PART = 0.02;
    private static final int PIECE = 16_384;

    private final byte[] media;
    private final int stallFrom;
    private final int stallTo;
    private final HttpServer server;
    private final ExecutorService threads = Executors.newCachedThreadPool();
    private final CountDownLatch going = new CountDownLatch(1);

    /** Sends that part of the file at once, from 0 to 1. */
    public StallingServer(String file, double part) throws IOException {
        media = Files.readAllBytes(Path.of(file));
        stallFrom = (int) (media.length * part);
        stallTo = (int) (media.length * (1 - INDEX_PART));
        server = HttpServer.create(
                new InetSocketAddress(InetAddress.getLoopbackAddress(), 0), 0);
        server.setExecutor(threads);
        server.createContext("/", this::answer);
        server.start();
    }

    public String url() {
        return "http://127.0.0.1:" + server.getAddress().getPort() + "/film.mkv";
    }

    /** Sends everything from now on. */
    public void goOn() {
        going.countDown();
    }

    private void answer(HttpExchange exchange) throws IOException {
        String range = exchange.getRequestHeaders().getFirst("Range");
        int first = range == null ? 0 : Integer.parseInt(range.replaceAll("bytes=(\\d+)-.*", "$1"));
        exchange.getResponseHeaders().set("Accept-Ranges", "bytes");
        exchange.getResponseHeaders().set(
                "Content-Range",
                "bytes " + first + "-" + (media.length - 1) + "/" + media.length);
        exchange.sendResponseHeaders(range == null ? 200 : 206, media.length - first);
        try (var body = exchange.getResponseBody()) {
            for (int at = first; at < media.length; at += PIECE) {
                int end = Math.min(media.length, at + PIECE);
                if (end > stallFrom && at < stallTo) {
                    body.flush();
                    awaitGoing();
                }
                body.write(media, at, end - at);
            }
        }
    }

    private void awaitGoing() throws IOException {
        try {
            going.await();
        } catch (InterruptedException e) {
            throw new InterruptedIOException();
        }
    }

    @Override
    public void close() {
        threads.shutdownNow();
        server.stop(0);
    }
}
