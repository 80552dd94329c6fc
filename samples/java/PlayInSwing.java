// SPDX-License-Identifier: Apache-2.0
import android.view.SurfaceView;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerState;
import java.awt.BorderLayout;
import java.awt.Dimension;
import java.awt.event.WindowAdapter;
import java.awt.event.WindowEvent;
import java.util.concurrent.CountDownLatch;
import javax.swing.JButton;
import javax.swing.JFrame;
import javax.swing.JPanel;
import javax.swing.JSlider;
import javax.swing.SwingUtilities;
import javax.swing.Timer;

/** A player in a Swing window: picture, a button for play and pause, a slider for the position. */
public final class PlayInSwing {
    private PlayInSwing() {}

    public static void main(String[] args) throws Exception {
        if (args.length != 1) {
            System.err.println("usage: PlayInSwing FILE|URL");
            System.exit(2);
        }
        CountDownLatch closed = new CountDownLatch(1);
        try (MediaPlayer player = new OrvMediaPlayer(SwingUtilities::invokeLater)) {
            player.setDataSource(args[0]);
            player.prepareAndWait();
            SwingUtilities.invokeAndWait(() -> show(player, args[0], closed));
            closed.await();
        } catch (MediaException e) {
            System.err.println(e.getMessage() + "; " + e.error().advice());
            System.exit(1);
        }
    }

    private static void show(MediaPlayer player, String title, CountDownLatch closed) {
        SurfaceView view = new SurfaceView();
        int width = Math.max(320, player.getVideoWidth());
        view.setPreferredSize(new Dimension(width, Math.max(180, player.getVideoHeight())));
        JButton button = new JButton("Play/Pause");
        button.addActionListener(event -> {
            boolean plays = player.getState() == PlayerState.STARTED;
            Runnable other = plays ? player::pause : player::start;
            other.run();
        });
        JSlider slider = new JSlider(0, Math.max(1, player.getDuration()), 0);
        slider.addChangeListener(event -> {
            if (slider.getValueIsAdjusting()) { // It moves by itself, too, which is no seek.
                player.seekTo(slider.getValue());
            }
        });
        Timer clock = new Timer(200, event -> {
            if (!slider.getValueIsAdjusting()) {
                slider.setValue(player.getCurrentPosition());
            }
        });
        JPanel controls = new JPanel(new BorderLayout());
        controls.add(button, BorderLayout.WEST);
        controls.add(slider);
        JFrame frame = new JFrame(title);
        frame.add(view);
        frame.add(controls, BorderLayout.SOUTH);
        frame.setDefaultCloseOperation(JFrame.DISPOSE_ON_CLOSE);
        frame.addWindowListener(new WindowAdapter() {
            @Override public void windowClosed(WindowEvent event) {
                clock.stop();
                closed.countDown();
            }
        });
        frame.pack(); // From here on the view has a surface.
        player.setSurface(view.getHolder().getSurface());
        player.start();
        clock.start();
        frame.setVisible(true);
    }
}
