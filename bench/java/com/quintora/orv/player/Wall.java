// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.util.ArrayList;
import java.util.List;

/**
 * A wall of players in one program, each of which draws into a surface of its own: a program with
 * two arguments, how many players and their film, which all play to its end at once. Prints how
 * many frames were shown and how many were dropped, of all players together.
 */
final class Wall {
    private Wall() {}

    public static void main(String[] arguments) throws Exception {
        List<Session> sessions = new ArrayList<>();
        for (int i = 0; i < Integer.parseInt(arguments[0]); i++) {
            PlayOptions options = PlayOptions.of(arguments[1]);
            Session session = new Session(options, image -> {});
            sessions.add(session);
            session.open();
        }
        sessions.forEach(Session::start);
        long shown = 0;
        long dropped = 0;
        for (Session session : sessions) {
            session.ended().await();
            if (session.failure() != null) {
                throw session.failure();
            }
            Snapshot end = session.snapshot();
            shown += end.framesShown();
            dropped += end.framesDropped();
        }
        sessions.forEach(Session::close);
        System.out.println(shown + " frames shown, " + dropped + " dropped");
    }
}
