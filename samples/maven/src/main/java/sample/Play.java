// SPDX-License-Identifier: Apache-2.0
package sample;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerListener;
import java.util.concurrent.CompletableFuture;

/** Prints a media file's duration and tracks, and plays it to its end without a window. */
public final class Play {
    private Play() {}

    public static void main(String[] arguments) throws Exception {
        CompletableFuture<String> end = new CompletableFuture<>();
        try (MediaPlayer player = new OrvMediaPlayer()) {
            player.addListener(new PlayerListener() {
                @Override
                public void onCompletion(MediaPlayer source) {
                    end.complete("played to the end");
                }

                @Override
                public void onError(MediaPlayer source, MediaException error) {
                    end.completeExceptionally(error);
                }
            });
            player.setDataSource(arguments[0]);
            player.prepareAndWait();
            System.out.println("duration: " + player.getDuration() + " ms");
            player.tracks().video().forEach(System.out::println);
            player.tracks().audio().forEach(System.out::println);
            player.tracks().subtitles().forEach(System.out::println);
            player.start();
            System.out.println(end.get());
        }
    }
}
