// SPDX-License-Identifier: Apache-2.0
import android.view.SurfaceView;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.event.WindowAdapter;
import java.awt.event.WindowEvent;
import java.util.concurrent.CountDownLatch;
import javax.swing.JFrame;
import javax.swing.SwingUtilities;
import javax.swing.Timer;

/** Shows a song's words over its film; they run through the colours and grow with each beat. */
public final class Karaoke {
    private static final int COLOURS_MS = 6000; // Once through the rainbow.
    private static final int BEAT_MS = 500;
    private static final int STYLE_MS = 100;

    private Karaoke() {}

    public static void main(String[] args) throws Exception {
        if (args.length != 2) {
            System.err.println("usage: Karaoke FILM WORDS.srt");
            System.exit(2);
        }
        CountDownLatch closed = new CountDownLatch(1);
        try (MediaPlayer player = new OrvMediaPlayer(SwingUtilities::invokeLater)) {
            player.setDataSource(args[0]);
            player.prepareAndWait();
            player.subtitles().addAndWait(args[1]);
            SwingUtilities.invokeAndWait(() -> show(player, closed));
            closed.await();
        } catch (MediaException e) {
            System.err.println(e.getMessage() + "; " + e.error().advice());
            System.exit(1);
        }
    }

    private static void show(MediaPlayer player, CountDownLatch closed) {
        SurfaceView view = new SurfaceView();
        view.setPreferredSize(new Dimension(
                Math.max(640, player.getVideoWidth()), Math.max(360, player.getVideoHeight())));
        Timer style = new Timer(STYLE_MS, event ->
                player.subtitles().setStyle(styleAt(player.getCurrentPosition())));
        JFrame frame = new JFrame("Karaoke");
        frame.add(view);
        frame.setDefaultCloseOperation(JFrame.DISPOSE_ON_CLOSE);
        frame.addWindowListener(new WindowAdapter() {
            @Override
            public void windowClosed(WindowEvent event) {
                style.stop();
                closed.countDown();
            }
        });
        frame.pack(); // From here on the view has a surface.
        player.setSurface(view.getHolder().getSurface());
        player.start();
        style.start();
        frame.setVisible(true);
    }

    /** What the attributes do not name, such as the outline, stays as it is. */
    private static SubtitleAttr styleAt(int millis) {
        float hue = millis % COLOURS_MS / (float) COLOURS_MS;
        int sinceBeat = millis % BEAT_MS;
        return SubtitleAttr.builder()
                .textColor(Color.HSBtoRGB(hue, 1, 1))
                .fontSize(80 - 24 * sinceBeat / BEAT_MS)
                .build();
    }
}
