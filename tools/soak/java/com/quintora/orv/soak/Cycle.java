// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import java.io.IOException;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Random;
import java.util.regex.Pattern;

/** One or several players' lives, chosen by the cycle's number and the run's seed alone. */
final class Cycle {
    private static final List<String> MEDIA = List.of("video.mp4", "video.mkv", "video.ts",
            "video.avi", "slides.mkv", "rotated.mp4", "tracks.mkv", "tracks.mp4", "tagged.mp3",
            "tagged.ogg", "covered.mp3", "covered.mkv", "tone.flac", "short.mp4", "silent.mkv",
            "counted-sound.mkv", "fonts.mkv");
    /** Those that are over in two seconds, to be played to their end. */
    private static final List<String> SHORT = List.of("silent.mkv", "short.mp4", "covered.mkv");
    /** Those that are long enough for a missing end to be no rounding of the duration. */
    private static final List<String> LONG = List.of("video.mkv", "video.avi", "tracks.mkv");
    private static final int MOST_ACTIONS = 6;
    private static final int WALL = 6;
    private static final int HUNDRED = 100;

    private final Run run;
    private final int number;
    private final Random random;
    private final FileSubjects files;

    Cycle(Run run, int number) {
        this.run = run;
        this.number = number;
        random = new Random(run.settings.seed() * 1_000_003 + number);
        random.nextInt(); // The first numbers of seeds that are neighbours are alike.
        files = new FileSubjects(run.settings.folder());
    }

    void live() throws Exception {
        run.plant.eachCycle();
        Pattern only = run.settings.only();
        if (random.nextInt(HUNDRED) < 5 && only.matcher("several players").find()) {
            wall();
        } else {
            Subject subject = choose();
            while (!only.matcher(subject.kind).find() && !run.plant.isUnnoticed(number)) {
                subject.close();
                subject = choose();
            }
            run.tally.count(subject.kind);
            live(new Session(run, number, random, subject));
        }
    }

    private void live(Session session) throws Exception {
        Subject subject = session.subject;
        if (random.nextInt(HUNDRED) < 8) {
            session.abandon();
        } else if (isWaitedForInVain(subject)) {
            session.act("open", () -> subject.open(session.player));
            session.act("prepareAsync", () -> session.player.prepareAsync());
            Thread.sleep(random.nextInt(300));
        } else if (session.open()) {
            use(session);
        }
        if (!subject.expectation.isWell() && random.nextBoolean()) {
            session.serveOn();
        }
        session.end();
    }

    /** Media that would take 20 seconds to fail are awaited now and then alone. */
    private boolean isWaitedForInVain(Subject subject) {
        return subject instanceof StreamSubject stream && stream.blocks()
                || subject instanceof HttpSubject server && server.stalls()
                        && random.nextInt(20) != 0;
    }

    private void use(Session session) throws Exception {
        if (session.subject.expectation.notice() == Expectation.Notice.PLAYING) {
            session.awaitFailure();
            return;
        }
        Actions actions = new Actions(session);
        int count = 2 + random.nextInt(MOST_ACTIONS);
        int disturbed = random.nextInt(count);
        for (int i = 0; i < count && actions.arePossible(); i++) {
            if (i == disturbed) {
                actions.play();
                session.act("the fault comes", session.subject::disturb);
            }
            if (actions.arePossible()) {
                actions.any();
            }
        }
        session.isUsable();
    }

    /** Several players that play at once. */
    private void wall() throws Exception {
        run.tally.count("several players");
        List<Session> sessions = new ArrayList<>();
        for (int i = 0; i < WALL; i++) {
            Session session = new Session(run, number, random, FileSubjects.whole(any(MEDIA)));
            sessions.add(session);
            session.open();
            new Actions(session).play();
        }
        for (Session session : sessions) {
            new Actions(session).any();
        }
        for (Session session : sessions) {
            session.isUsable();
            session.end();
        }
    }

    private Path any(List<String> names) {
        return run.settings.media().resolve(names.get(random.nextInt(names.size())));
    }

    private Subject choose() throws IOException {
        if (run.plant.isUnnoticed(number)) {
            return FileSubjects.takenForEmpty(any(MEDIA));
        }
        int percent = random.nextInt(HUNDRED);
        if (percent < 40) {
            return healthy(percent);
        }
        return percent < 70 ? file(percent - 40) : elsewhere(percent - 70);
    }

    private Subject healthy(int percent) throws IOException {
        if (percent < 28) {
            return FileSubjects.whole(any(MEDIA));
        }
        if (percent < 32) {
            return FileSubjects.descriptor(any(MEDIA));
        }
        return percent < 36 ? StreamSubject.of(any(MEDIA)) : HttpSubject.whole(any(MEDIA), random);
    }

    private Subject file(int percent) throws IOException {
        if (percent < 10) {
            return files.damaged(number, any(MEDIA), random);
        }
        if (percent < 17) {
            return files.truncated(number, any(MEDIA), random);
        }
        if (percent < 21) {
            return files.shrinking(number, any(MEDIA), random);
        }
        if (percent < 25) {
            return files.vanishing(number, any(MEDIA));
        }
        return switch (percent) {
            case 25 -> files.empty(number, any(MEDIA));
            case 26 -> files.noise(number, any(MEDIA), random);
            case 27, 28 -> files.gone(number, any(MEDIA));
            default -> FileSubjects.missing(run.settings.folder());
        };
    }

    private Subject elsewhere(int percent) throws IOException {
        if (percent < 4) {
            return HttpSubject.refusing(any(MEDIA), random);
        }
        if (percent < 8) {
            return HttpSubject.flaky(any(MEDIA), random);
        }
        if (percent < 12) {
            return HttpSubject.dying(any(MEDIA), random);
        }
        if (percent < 14) {
            return HttpSubject.absent(any(MEDIA), random);
        }
        if (percent < 17) {
            return HttpSubject.cut(any(LONG), random);
        }
        if (percent < 20) {
            return HttpSubject.stalling(any(MEDIA), random);
        }
        if (percent < 23) {
            return StreamSubject.failing(any(SHORT), 0.8 * random.nextDouble());
        }
        if (percent < 26) {
            return StreamSubject.blocking(any(MEDIA), 0.9 * random.nextDouble());
        }
        return percent < 28 ? run.withoutSound(any(MEDIA)) : run.onFullDisk(any(MEDIA));
    }
}
