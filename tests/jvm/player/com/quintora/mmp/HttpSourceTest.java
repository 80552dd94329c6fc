// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.sun.net.httpserver.HttpExchange;
import com.sun.net.httpserver.HttpServer;
import java.io.IOException;
import java.io.OutputStream;
import java.net.InetAddress;
import java.net.InetSocketAddress;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.Map;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** Media from a server on this machine. */
class HttpSourceTest extends PlayerFixture {
    private final List<Map<String, List<String>>> requests = new CopyOnWriteArrayList<>();
    private final ExecutorService threads = Executors.newCachedThreadPool();
    private HttpServer server;
    private byte[] media;

    @BeforeEach
    void serve() throws Exception {
        media = Files.readAllBytes(Path.of(Media.path("video.mp4")));
        server = HttpServer.create(
                new InetSocketAddress(InetAddress.getLoopbackAddress(), 0), 0);
        server.setExecutor(threads);
        server.createContext("/film.mp4", this::answer);
        server.start();
    }

    @AfterEach
    void stopServing() {
        player.close();
        server.stop(0);
        threads.shutdownNow();
    }

    @Test
    void aUrlIsPlayedAndSought() throws Exception {
        open(url("/film.mp4"));
        assertEquals(10_000, player.getDuration(), 50);
        player.seekToAndWait(6000);
        assertEquals(6000, player.getCurrentPosition(), 40);
        player.start();
        awaitMoving();
    }

    @Test
    void headersGoWithEveryRequest() throws Exception {
        player.setDataSource(url("/film.mp4"),
                Map.of("X-Ticket", "a, b; c", "User-Agent", "tests/1"));
        player.prepareAndWait();
        player.seekToAndWait(8000);
        assertFalse(requests.isEmpty());
        for (Map<String, List<String>> headers : requests) {
            assertEquals(List.of("a, b; c"), headers.get("X-ticket"));
            assertEquals(List.of("tests/1"), headers.get("User-agent"));
        }
    }

    @Test
    void headersDoNotOutliveTheirMedia() throws Exception {
        player.setDataSource(url("/film.mp4"), Map.of("X-Ticket", "old"));
        player.prepareAndWait();
        player.resetAndWait();
        requests.clear();
        open(url("/film.mp4"));
        assertFalse(requests.isEmpty());
        for (Map<String, List<String>> headers : requests) {
            assertFalse(headers.containsKey("X-ticket"));
        }
    }

    @Test
    void noHeadersAreHeadersToo() throws Exception {
        player.setDataSource(url("/film.mp4"), Map.of());
        player.prepareAndWait();
        assertEquals(10_000, player.getDuration(), 50);
    }

    @Test
    void whatTheServerDoesNotHaveIsRefused() throws Exception {
        player.setDataSource(url("/nothing.mp4"));
        MediaException e = assertThrows(MediaException.class, player::prepareAndWait);
        assertEquals(
                url("/nothing.mp4") + ": the server has no such media (HTTP status 404)",
                e.getMessage());
        assertEquals(MediaError.HTTP, e.error());
        assertEquals(OptionalInt.of(404), e.httpStatus());
        player.resetAndWait();
        open(url("/film.mp4"));
    }

    @Test
    void theCurrentTracksAreKnownWithoutAnotherRequest() throws Exception {
        open(url("/film.mp4"));
        int before = requests.size();
        assertEquals(OptionalInt.of(0), player.tracks().currentIndex(Track.Kind.AUDIO));
        assertEquals(OptionalInt.empty(), player.tracks().currentIndex(Track.Kind.SUBTITLE));
        assertEquals(before, requests.size());
        player.resetAndWait();
        assertEquals(Optional.empty(), player.tracks().currentAudio());
    }

    private String url(String path) {
        return "http://127.0.0.1:" + server.getAddress().getPort() + path;
    }

    /** Answers with the range that is asked for. */
    private void answer(HttpExchange exchange) throws IOException {
        requests.add(Map.copyOf(exchange.getRequestHeaders()));
        String range = exchange.getRequestHeaders().getFirst("Range");
        int from = range == null ? 0 : Integer.parseInt(range.replaceAll("bytes=(\\d+)-.*", "$1"));
        exchange.getResponseHeaders().add("Accept-Ranges", "bytes");
        exchange.getResponseHeaders().add(
                "Content-Range", "bytes " + from + "-" + (media.length - 1) + "/" + media.length);
        exchange.sendResponseHeaders(range == null ? 200 : 206, media.length - from);
        try (OutputStream body = exchange.getResponseBody()) {
            body.write(media, from, media.length - from);
        } catch (IOException e) {
            return; // The player has read enough.
        }
    }
}
