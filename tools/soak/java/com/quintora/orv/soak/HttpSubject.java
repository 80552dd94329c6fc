// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaPlayer;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Random;

/** Media from a server of this program's on this machine, which may be a bad one. */
final class HttpSubject extends Subject {
    private final Server server;
    private final boolean dies;

    private HttpSubject(Server.Manner manner, Path media, Random random, Expectation expectation,
            boolean dies) throws IOException {
        super("server that " + (dies ? "dies" : manner.words), media.getFileName().toString(),
                expectation);
        server = new Server(manner, Files.readAllBytes(media), random.nextDouble());
        this.dies = dies;
    }

    static Subject whole(Path media, Random random) throws IOException {
        return new HttpSubject(Server.Manner.ANSWERS, media, random, Expectation.WELL, false);
    }

    /** An error status, which must be reported. */
    static Subject refusing(Path media, Random random) throws IOException {
        return new HttpSubject(Server.Manner.REFUSES, media, random,
                Expectation.opening(MediaError.HTTP), false);
    }

    /** Nobody listens. */
    static Subject absent(Path media, Random random) throws IOException {
        HttpSubject subject = new HttpSubject(Server.Manner.ANSWERS, media, random,
                Expectation.opening(MediaError.CANNOT_CONNECT), false);
        subject.server.close();
        return subject;
    }

    /** Sends a part of what it announces, always the same, and knows no ranges. */
    static Subject cut(Path media, Random random) throws IOException {
        return new HttpSubject(Server.Manner.CUTS, media, random,
                Expectation.playing(Expectation.CONNECTION), false);
    }

    /** Closes each connection somewhere, but goes on from any byte. */
    static Subject flaky(Path media, Random random) throws IOException {
        return new HttpSubject(Server.Manner.BREAKS, media, random,
                Expectation.perhaps(Expectation.CONNECTION), false);
    }

    /** Falls silent in the middle. */
    static Subject stalling(Path media, Random random) throws IOException {
        return new HttpSubject(Server.Manner.STALLS, media, random,
                Expectation.perhaps(Expectation.CONNECTION), false);
    }

    /** Stops for good once the media play. */
    static Subject dying(Path media, Random random) throws IOException {
        return new HttpSubject(Server.Manner.ANSWERS, media, random,
                Expectation.perhaps(Expectation.CONNECTION), true);
    }

    boolean stalls() {
        return server.stalls();
    }

    @Override
    void open(MediaPlayer player) throws IOException {
        player.setDataSource(server.url());
    }

    @Override
    void disturb() {
        if (dies) {
            server.close();
        }
    }

    @Override
    public void close() {
        server.close();
    }
}
