// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.File;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;

/** A PulseAudio daemon of this run's own, which plays to nowhere. */
final class SoundServer implements AutoCloseable {
    private static final long START_NANOS = 10_000_000_000L;

    private final Path socket;
    private Process daemon;

    SoundServer(Path socket) throws IOException, InterruptedException {
        this.socket = socket;
        start();
    }

    /** Kills it, as a crash would. */
    synchronized void kill() throws InterruptedException, IOException {
        daemon.destroyForcibly().waitFor();
        Files.deleteIfExists(socket);
    }

    /** Begins anew; one that was killed before is replaced, one that runs goes on. */
    synchronized void start() throws IOException, InterruptedException {
        if (daemon != null && daemon.isAlive()) {
            return;
        }
        ProcessBuilder builder = new ProcessBuilder("pulseaudio", "-n", "--daemonize=no",
                "--use-pid-file=no", "--exit-idle-time=-1", "--disable-shm=yes",
                "--load=module-null-sink",
                "--load=module-native-protocol-unix auth-anonymous=1 socket=" + socket);
        builder.redirectErrorStream(true);
        builder.redirectOutput(ProcessBuilder.Redirect.appendTo(log()));
        daemon = builder.start();
        long from = System.nanoTime();
        while (!Files.exists(socket)) {
            if (!daemon.isAlive() || System.nanoTime() - from > START_NANOS) {
                throw new IOException("pulseaudio does not start; " + log() + " says why");
            }
            Thread.sleep(10);
        }
    }

    private File log() {
        return new File(socket + ".log");
    }

    @Override
    public synchronized void close() {
        daemon.destroyForcibly();
    }
}
