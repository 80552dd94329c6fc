// SPDX-License-Identifier: Apache-2.0
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import java.util.concurrent.CountDownLatch;

/** Plays media without a picture and prints all that is reported, with its time in seconds. */
public final class EventLog implements PlayerListener {
    private final long begin = System.nanoTime();
    private final CountDownLatch end = new CountDownLatch(1);

    private EventLog() {}

    public static void main(String[] args) throws Exception {
        if (args.length != 1) {
            System.err.println("usage: EventLog FILE|URL");
            System.exit(2);
        }
        EventLog log = new EventLog();
        try (MediaPlayer player = new OrvMediaPlayer()) {
            player.addListener(log);
            player.setDataSource(args[0]);
            player.prepareAsync(); // The listener goes on from there.
            log.end.await();
        } catch (MediaException e) {
            System.err.println(e.getMessage() + "; " + e.error().advice());
            System.exit(1);
        }
    }

    private void print(MediaPlayer player, String event) {
        System.out.printf("%8.3f  at %7.3f  %-9s  %s%n", (System.nanoTime() - begin) / 1e9,
                player.getCurrentPosition() / 1e3, player.getState(), event);
    }

    @Override
    public void onPrepared(MediaPlayer player) {
        print(player, "prepared, " + player.duration().map(Object::toString).orElse("endless"));
        player.start();
    }

    @Override
    public void onCompletion(MediaPlayer player) {
        print(player, "completion");
        end.countDown();
    }

    @Override
    public void onSeekComplete(MediaPlayer player) {
        print(player, "seek complete");
    }

    @Override
    public void onVideoSizeChanged(MediaPlayer player, int width, int height) {
        print(player, "picture of " + width + "x" + height);
    }

    @Override
    public void onBufferingUpdate(MediaPlayer player, int percent) {
        print(player, "buffered " + percent + "%");
    }

    @Override
    public void onError(MediaPlayer player, MediaException e) {
        print(player, "error " + e.error() + ": " + e.getMessage() + "; " + e.error().advice());
        end.countDown();
    }

    @Override
    public void onInfo(MediaPlayer player, PlaybackInfo info) {
        print(player, "info " + info.kind() + " (" + info.what() + ", " + info.extra() + ")");
    }

    @Override
    public void onTimedText(MediaPlayer player, byte[] payload) {
        print(player, "text of " + (payload == null ? 0 : payload.length) + " bytes");
    }
}
