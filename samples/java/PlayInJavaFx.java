// SPDX-License-Identifier: Apache-2.0
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.util.Arrays;
import javafx.application.Application;
import javafx.application.Platform;
import javafx.scene.Scene;
import javafx.scene.image.ImageView;
import javafx.scene.image.PixelFormat;
import javafx.scene.image.WritableImage;
import javafx.scene.layout.StackPane;
import javafx.stage.Stage;

/** A player in a JavaFX window: the frames are lent by a FrameReader and drawn into an image. */
public final class PlayInJavaFx {
    private static MediaPlayer player;
    private static FrameReader frames;

    private PlayInJavaFx() {}

    public static void main(String[] args) throws Exception {
        if (args.length != 1) {
            System.err.println("usage: PlayInJavaFx FILE|URL");
            System.exit(2);
        }
        try (MediaPlayer opened = new OrvMediaPlayer(); FrameReader reader = new FrameReader()) {
            player = opened;
            frames = reader;
            player.setDataSource(args[0]);
            player.setSurface(frames.getSurface());
            player.prepareAndWait();
            Application.launch(Window.class, args); // Returns when the window is closed.
        } catch (MediaException e) {
            System.err.println(e.getMessage() + "; " + e.error().advice());
            System.exit(1);
        }
    }

    /** What JavaFX makes and runs on its own thread. */
    public static final class Window extends Application {
        private final ImageView view = new ImageView();
        private WritableImage image = new WritableImage(1, 1);
        private int[] pixels = {};

        @Override
        public void start(Stage stage) {
            stage.setTitle(getParameters().getRaw().get(0));
            stage.setScene(new Scene(new StackPane(view),
                    Math.max(320, player.getVideoWidth()), Math.max(180, player.getVideoHeight())));
            frames.setOnFrameAvailable(this::draw, Platform::runLater);
            stage.show();
            player.start();
        }

        private void draw() {
            try (VideoFrame frame = frames.acquireLatestFrame()) {
                if (frame == null) {
                    return; // Shown already, by a notice that came for two frames.
                }
                int width = frame.getWidth();
                int height = frame.getHeight();
                if (image.getWidth() != width || image.getHeight() != height) {
                    image = new WritableImage(width, height);
                    pixels = new int[width * height];
                    view.setImage(image);
                }
                for (int y = 0; y < height; y++) {
                    frame.getPixels().asIntBuffer().position(y * frame.getRowStride() / 4)
                            .get(pixels, y * width, width);
                }
                Arrays.setAll(pixels, i -> pixels[i] | 0xFF000000); // No alpha in frames.
                image.getPixelWriter().setPixels(
                        0, 0, width, height, PixelFormat.getIntArgbInstance(), pixels, 0, width);
            }
        }
    }
}
