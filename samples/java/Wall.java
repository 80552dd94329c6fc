// SPDX-License-Identifier: Apache-2.0
import android.view.SurfaceView;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import java.awt.Dimension;
import java.awt.GridLayout;
import java.awt.event.WindowAdapter;
import java.awt.event.WindowEvent;
import java.util.ArrayDeque;
import java.util.Deque;
import java.util.concurrent.CountDownLatch;
import javax.swing.JFrame;
import javax.swing.SwingUtilities;

/** Several films at once in one window, over and over; the first one is heard. */
public final class Wall implements AutoCloseable {
    private static final Dimension CELL = new Dimension(320, 180);

    private final Deque<MediaPlayer> players = new ArrayDeque<>();
    private final CountDownLatch closed = new CountDownLatch(1);

    private Wall() {}

    public static void main(String[] args) throws Exception {
        if (args.length == 0) {
            System.err.println("usage: Wall FILE|URL...");
            System.exit(2);
        }
        try (Wall wall = new Wall()) {
            for (String film : args) {
                wall.add(film);
            }
            SwingUtilities.invokeAndWait(wall::show);
            wall.closed.await();
        } catch (MediaException e) {
            System.err.println(e.getMessage() + "; " + e.error().advice());
            System.exit(1);
        }
    }

    private void add(String film) throws Exception {
        MediaPlayer player = new OrvMediaPlayer();
        player.audio().setMuted(!players.isEmpty());
        players.add(player); // Before what may throw: close() then finds it.
        player.setLooping(true);
        player.setDataSource(film);
        player.prepareAndWait();
    }

    private void show() {
        JFrame frame = new JFrame("Wall");
        frame.setLayout(new GridLayout(0, (int) Math.ceil(Math.sqrt(players.size())), 2, 2));
        for (int i = 0; i < players.size(); i++) {
            SurfaceView view = new SurfaceView();
            view.setPreferredSize(CELL);
            frame.add(view);
        }
        frame.setDefaultCloseOperation(JFrame.DISPOSE_ON_CLOSE);
        frame.addWindowListener(new WindowAdapter() {
            @Override
            public void windowClosed(WindowEvent event) {
                closed.countDown();
            }
        });
        frame.pack(); // From here on the views have surfaces.
        int cell = 0;
        for (MediaPlayer player : players) {
            SurfaceView view = (SurfaceView) frame.getContentPane().getComponent(cell++);
            player.setSurface(view.getHolder().getSurface());
            player.start();
        }
        frame.setVisible(true);
    }

    @Override
    public void close() {
        players.forEach(MediaPlayer::close);
    }
}
