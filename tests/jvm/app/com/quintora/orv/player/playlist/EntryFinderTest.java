// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.quintora.orv.player.Failure;
import com.sun.net.httpserver.HttpServer;
import java.net.InetAddress;
import java.net.InetSocketAddress;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Folders and playlists, and what is neither. */
class EntryFinderTest {
    @TempDir Path folder;

    @Test
    void aFolderIsItsMediaInTheOrderOfTheirNames() throws Exception {
        for (String name : List.of("b10.mkv", "b9.MKV", "notes.txt", ".hidden.mkv", "C/a.mp3")) {
            write(name, "");
        }
        write(".cache/x.mkv", "");
        assertEquals(paths("b9.MKV", "b10.mkv", "C/a.mp3"), find(folder.toString()));
    }

    @Test
    void aFolderWithoutMediaIsOneSentence() throws Exception {
        write("notes.txt", "");
        assertFails("'" + folder + "' has no media files", folder.toString());
    }

    @Test
    void aPlaylistNamesPathsFromItsOwnFolder() throws Exception {
        write("a/one.mkv", "");
        String list = write(
                "list.m3u8",
                "\uFEFF#EXTM3U\r\n#EXTINF:12,Éine, two\r\na/one.mkv\r\n\r\n#EXTINF:3\n"
                        + "/abs/two.mkv\n# a remark\nhttp://host/three\n");
        List<Entry> entries = EntryFinder.find(List.of(list));
        assertEquals(
                List.of(
                        new Entry(folder.resolve("a/one.mkv").toString(), "Éine, two"),
                        new Entry("/abs/two.mkv"),
                        new Entry("http://host/three")),
                entries);
    }

    @Test
    void listsOfOtherSystemsAreRead() throws Exception {
        write("a/one.mkv", "");
        Path list = folder.resolve("list.m3u");
        String text = "#EXTINF:1,\u00c9t\u00e9\na\\one.mkv\n";
        Files.write(list, text.getBytes(StandardCharsets.ISO_8859_1));
        assertEquals(
                List.of(new Entry(folder.resolve("a/one.mkv").toString(), "Été")),
                EntryFinder.find(List.of(list.toString())));
    }

    @Test
    void aPlsListIsInTheOrderOfItsNumbers() throws Exception {
        String list = write(
                "list.pls",
                "[playlist]\nFile10=http://host/ten\nfile2=two.mkv\nTitle2=Two\nLength2=-1\n"
                        + "NumberOfEntries=2\n");
        assertEquals(
                List.of(
                        new Entry(folder.resolve("two.mkv").toString(), "Two"),
                        new Entry("http://host/ten")),
                EntryFinder.find(List.of(list)));
    }

    @Test
    void aListOfSegmentsIsMedia() throws Exception {
        String list = write("live.m3u8", "#EXTM3U\n#EXT-X-VERSION:3\n#EXTINF:4,\na.ts\n");
        assertEquals(List.of(list), find(list));
    }

    @Test
    void listsMayNameListsAndFolders() throws Exception {
        write("music/1.mp3", "");
        write("inner.m3u", "music\n");
        assertEquals(paths("music/1.mp3"), find(write("outer.m3u", "inner.m3u\n")));
    }

    @Test
    void aListOfItselfIsOneSentence() throws Exception {
        String list = write("self.m3u", "self.m3u\n");
        assertFails("'" + list + "' is a playlist in a playlist, again and again", list);
    }

    @Test
    void aListWithoutEntriesIsOneSentence() throws Exception {
        String list = write("empty.pls", "[playlist]\n");
        assertFails("the playlist '" + list + "' has no entries", list);
    }

    @Test
    void aListOnAServerNamesAddressesFromThere() throws Exception {
        HttpServer server =
                HttpServer.create(new InetSocketAddress(InetAddress.getLoopbackAddress(), 0), 0);
        byte[] list = "#EXTM3U\nfilm one.mkv\n".getBytes(StandardCharsets.UTF_8);
        server.createContext("/", exchange -> {
            exchange.sendResponseHeaders(200, list.length);
            exchange.getResponseBody().write(list);
            exchange.close();
        });
        server.start();
        try {
            String base = "http://127.0.0.1:" + server.getAddress().getPort() + "/lists/";
            assertEquals(List.of(base + "film%20one.mkv"), find(base + "radio.m3u?id=1"));
        } finally {
            server.stop(0);
        }
    }

    @Test
    void filesOfUrlsArePaths() throws Exception {
        assertEquals(List.of("/a b.mkv"), find("file:///a%20b.mkv"));
        assertEquals(List.of("-", "none.mkv", ""), find("-", "none.mkv", ""));
    }

    private String write(String name, String text) throws Exception {
        Path file = folder.resolve(name);
        Files.createDirectories(file.getParent());
        return Files.writeString(file, text).toString();
    }

    private List<String> paths(String... names) {
        return List.of(names).stream().map(name -> folder.resolve(name).toString()).toList();
    }

    private static List<String> find(String... sources) throws Failure {
        return EntryFinder.find(List.of(sources)).stream().map(Entry::source).toList();
    }

    private static void assertFails(String sentence, String source) {
        assertEquals(
                sentence, assertThrows(Failure.class, () -> find(source)).getMessage());
    }
}
