// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.mmp.desktop.VideoFrame;
import com.quintora.orv.player.Previews;
import com.quintora.orv.player.ReadingOrder;
import com.quintora.orv.player.Snapshot;
import com.quintora.orv.player.playlist.Playlist;
import java.awt.Color;
import java.awt.Component;
import java.awt.Dimension;
import java.awt.EventQueue;
import java.awt.Frame;
import java.awt.Graphics;
import java.awt.GraphicsEnvironment;
import java.awt.Rectangle;
import java.awt.event.ComponentAdapter;
import java.awt.event.ComponentEvent;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.awt.event.MouseWheelEvent;
import java.awt.event.WindowAdapter;
import java.awt.event.WindowEvent;
import java.awt.image.BufferedImage;
import java.awt.image.VolatileImage;
import java.util.List;
import java.util.Locale;
import java.util.Map;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ExecutionException;
import java.util.function.Consumer;
import java.util.function.Supplier;
import javax.swing.JFrame;
import javax.swing.JPopupMenu;
import javax.swing.LayoutFocusTraversalPolicy;
import javax.swing.SwingUtilities;
import javax.swing.Timer;
import javax.swing.ToolTipManager;
import javax.swing.WindowConstants;

/** The window: the picture or a message, and the controls. On the window's thread but for draw. */
final class Stage {
    private static final String VIDEO = "video";
    private static final String SURFACE = "surface";
    private static final String MESSAGE = "message";
    private static final double LARGEST_PART_OF_SCREEN = 0.8;
    private static final int OPENING_MS = 400;
    private static final int LONG_SEEK_LOOKS = 5;

    private volatile String name;
    private final VideoPane video = new VideoPane(this::requestFrames);
    private final NoticePane room = new NoticePane();
    private JFrame frame;
    private ControlBar bar;
    private SeekPreview preview;
    private Deck deck;
    private final Help help = new Help();
    // Most media open so quickly that a word about it would only flicker.
    private final Timer opening = new Timer(OPENING_MS, event -> showOpening());
    private final Clicks clicks = new Clicks(this::togglePlaying, this::toggleFullScreen);
    private FullScreen fullScreen;
    private MessagePanel message;
    private Conductor conductor;
    private List<ActionGroup> actions;
    private SideRoom side;
    private ListPanel list; // Once it was opened.
    private Drops drops;
    private Dimension videoSize;
    private boolean isFitted;
    private volatile Rectangle before;
    private volatile Rectangle last;
    private boolean buffering;
    private int seekingLooks;
    private Runnable onClosed;
    private final PictureWay way;
    private final CompletableFuture<Optional<DesktopSurfaceView>> view = new CompletableFuture<>();
    private DesktopSurfaceView surface; // Once the graphics processor draws on it.
    private volatile boolean isDropped;
    private String shown = VIDEO;

    /** The name stands in the title bar. */
    Stage(String name, PictureWay way) {
        this.name = name;
        this.way = way;
    }

    /** Opens where the window was before, if that is remembered. To be called before it is open. */
    void restore(Map<String, String> remembered) {
        WindowPlace.in(remembered).ifPresent(place -> before = place);
    }

    /** Where the window is, or was when it was closed. Any thread. */
    Optional<Rectangle> place() {
        return Optional.ofNullable(last);
    }

    void open(Conductor conductor, Runnable onClosed) {
        try {
            build(conductor, onClosed);
            frame.setVisible(true);
            EventQueue.invokeLater(() -> frame.setIconImages(AppIcon.images()));
            view.complete(addView());
        } finally {
            view.complete(Optional.empty()); // Unless there is one.
        }
        opening.start();
    }

    /** All that can be done before the window shows. */
    void build(Conductor conductor, Runnable onClosed) {
        this.conductor = conductor;
        this.onClosed = onClosed;
        Theme.install();
        frame = new JFrame(name);
        bar = new ControlBar(conductor);
        preview = new SeekPreview(bar.seekBar());
        message = new MessagePanel(conductor::chooseFiles);
        room.add(video, VIDEO);
        room.add(message, MESSAGE);
        side = new SideRoom(room::requestFocusInWindow);
        deck = new Deck(room, bar, side);
        frame.add(deck);
        frame.setGlassPane(help);
        fullScreen = new FullScreen(frame, deck, bar);
        actions = WindowActions.of(conductor, bar);
        Keys.bind(deck, actions);
        help.list(actions);
        opening.setRepeats(false);
        giveFocusToPicture();
        listen();
        drops = new Drops(conductor);
        drops.playOn(frame.getRootPane());
        showList(conductor.list());
        room.setPreferredSize(withinScreen(854, 480, LARGEST_PART_OF_SCREEN));
        frame.setMinimumSize(withinScreen(480, 300, 1));
        frame.pack();
        frame.setLocationRelativeTo(null);
        if (before != null) {
            isFitted = true;
            frame.setBounds(before);
        }
    }

    /** Paints a window that is not shown, as the screen would be painted. */
    void drawUnseen() {
        VolatileImage target = frame.createVolatileImage(frame.getWidth(), frame.getHeight());
        Graphics graphics = target.createGraphics();
        frame.getRootPane().paint(graphics);
        graphics.dispose();
        target.flush();
    }

    /** A view with a surface, out of sight, for the graphics processor to be tried on. */
    private Optional<DesktopSurfaceView> addView() {
        if (!way.isTried()) {
            return Optional.empty();
        }
        DesktopSurfaceView made = way.makeView();
        made.setFocusable(false);
        room.add(made, SURFACE);
        frame.validate();
        return Optional.of(made);
    }

    /** Waits for the window, if that is to have a view. Not for the window's thread. */
    Optional<DesktopSurfaceView> awaitView() throws InterruptedException {
        try {
            return way.isTried() && !isDropped ? view.get() : Optional.empty();
        } catch (ExecutionException e) {
            return Optional.empty();
        }
    }

    /** The graphics processor draws on the view, whose window covers what is painted. */
    void drawOn(DesktopSurfaceView drawn) {
        if (surface == drawn) {
            return;
        }
        surface = drawn;
        JPopupMenu.setDefaultLightWeightPopupEnabled(false);
        ToolTipManager.sharedInstance().setLightWeightPopupEnabled(false);
        deck.keepApart();
        room.writeOver(surface);
        surface.addMouseListener(clicks);
        surface.addMouseListener(menuOpener());
        surface.addMouseWheelListener(this::onWheel);
        surface.getHolder().addCallback(new NewSurfaces(() -> conductor.drawOnNewSurfaceOf(drawn)));
        help.addComponentListener(
                new ComponentAdapter() {
                    @Override
                    public void componentShown(ComponentEvent event) {
                        showCard(shown);
                    }

                    @Override
                    public void componentHidden(ComponentEvent event) {
                        showCard(shown);
                    }
                });
    }

    /** Nothing is drawn on the view that was tried. */
    void dropView(DesktopSurfaceView unused) {
        surface = null;
        isDropped = true;
        room.remove(unused);
    }

    private void showPicture() {
        showCard(surface == null ? VIDEO : SURFACE);
    }

    // The list of keys would lie below the picture's window.
    private void showCard(String card) {
        shown = card;
        boolean isCovered = card.equals(SURFACE) && help.isVisible();
        room.show(isCovered ? VIDEO : card);
    }

    /** What is called with each frame, on the frames' thread. Any thread. */
    Consumer<VideoFrame> screen() {
        return video.screen();
    }

    /** Other media begins, which is called so: gives what is called with its frames. */
    Consumer<VideoFrame> newScreen(String title) {
        name = title;
        frame.setTitle(title);
        videoSize = null;
        buffering = false;
        room.keepTelling("");
        bar.showSomethingToPlay();
        bar.seekBar().showChapters(Chapters.NONE);
        bar.seekBar().showSection(RepeatMarks.NONE);
        preview.use(null);
        opening.restart();
        return video.begin();
    }

    private void showOpening() {
        tellInstead(Glyph.PLAY, Theme.ACCENT, name, "Opening…");
    }

    void showMedia(MediaDetails details) {
        opening.stop();
        if (details.hasVideo()) {
            showPicture();
        } else {
            showCard(VIDEO);
        }
        showTracks(details);
        bar.seekBar().showChapters(details.chapters());
        conductor.showVolume();
        if (!details.title().isEmpty()) {
            frame.setTitle(details.title());
        }
        if (details.cover() != null) {
            video.draw(details.cover());
        } else if (!details.hasVideo()) {
            String title = details.title().isEmpty() ? name : details.title();
            tellInstead(Glyph.AUDIO, Theme.ACCENT, title, ReadingOrder.ofName(details.artist()));
        }
    }

    void showTracks(MediaDetails details) {
        bar.showTracks(details.audioTracks(), details.subtitleTracks());
    }

    void showVideoSize(int width, int height) {
        videoSize = new Dimension(width, height);
        if (!isFitted && !fullScreen.isOn()) {
            isFitted = true;
            fitWindow();
        }
        requestFrames();
    }

    /** Whether the media waits for data, once it plays. */
    void setBuffering(boolean waits) {
        buffering = waits;
    }

    /** Says what the user waits for; a seek that is quick is not worth a word. */
    void showWaiting(boolean seeks, boolean plays) {
        seekingLooks = seeks ? seekingLooks + 1 : 0;
        boolean isLongSeek = seekingLooks > LONG_SEEK_LOOKS;
        room.keepTelling(isLongSeek ? "Seeking…" : buffering && plays ? "Buffering…" : "");
    }

    void show(Snapshot now) {
        bar.show(now);
        fullScreen.showPlaying(now.playing());
    }

    /** Where pictures of places come from, above the bar. */
    void showPreviews(Previews previews) {
        preview.use(previews);
    }

    /** Such a picture is there. */
    void showPreview(int part, BufferedImage image) {
        preview.show(part, image);
    }

    /** What is repeated. */
    void showSection(RepeatMarks marks) {
        bar.seekBar().showSection(marks);
    }

    void showVolume(double level, boolean muted) {
        bar.showVolume(level, muted);
    }

    void showFailure(String sentence) {
        opening.stop();
        room.keepTelling("");
        bar.showNothingToPlay();
        message.tell(Glyph.ALERT, Theme.ALERT, "This cannot be played", sentence, true);
        showCard(MESSAGE);
    }

    /** A few words on the picture, or on the message in its place. */
    void tell(String words) {
        room.tell(words);
    }

    /** The same for long enough to be read, of what was not asked for. */
    void tellLong(String words) {
        room.tellLong(words);
    }

    boolean fillsScreen() {
        return fullScreen.isOn();
    }

    void raise() {
        frame.setExtendedState(frame.getExtendedState() & ~Frame.ICONIFIED);
        frame.toFront();
        frame.requestFocus();
    }

    private void togglePlaying() {
        conductor.togglePlaying();
    }

    void toggleFullScreen() {
        fullScreen.set(!fullScreen.isOn());
        bar.showFullScreen(fullScreen.isOn());
    }

    void toggleHelp() {
        help.setVisible(!help.isVisible());
    }

    /** Closes the list of keys, or else the panel, or else leaves the full screen. */
    void leave() {
        if (help.isVisible()) {
            help.setVisible(false);
        } else if (side.isOpen()) {
            side.close();
        } else if (fullScreen.isOn()) {
            toggleFullScreen();
        }
    }

    void toggleList() {
        side.toggle("list", this::makeList);
    }

    private ListPanel makeList() {
        list = new ListPanel(conductor);
        drops.addOn(list);
        list.show(conductor.list());
        return list;
    }

    /** How the picture is drawn, in words. */
    String describeDrawing() {
        return way.describe();
    }

    /** Shows or hides the panel of that name, which is made when it is first asked for. */
    void togglePanel(String name, Supplier<SidePanel> maker) {
        side.toggle(name, maker);
    }

    /** The list has changed, or what plays of it. */
    void showList(Playlist changed) {
        if (list != null) {
            list.show(changed);
        }
        bar.showPlaces(changed.entries().size() > 1);
    }

    void chooseFiles() {
        later(new OpenDialog(frame, conductor)::chooseFiles);
    }

    void addSubtitleFile() {
        later(new OpenDialog(frame, conductor)::chooseSubtitles);
    }

    void chooseAddress() {
        later(new OpenDialog(frame, conductor)::chooseAddress);
    }

    // The letter of the key that asks for a dialog must not go into its field.
    private static void later(Runnable dialog) {
        EventQueue.invokeLater(dialog);
    }

    /** All that the window does, above the bar's button for it. */
    void openMenu() {
        fullScreen.showControls();
        ActionMenu.openAbove(bar.menuButton(), actions);
    }

    /** Says so where there is nothing to choose. */
    void openMenu(Component above, String title, List<ChoiceMenu.Choice> choices) {
        if (choices.isEmpty()) {
            tell("No " + title.toLowerCase(Locale.ROOT));
            return;
        }
        fullScreen.showControls();
        ChoiceMenu.open(above, title, choices);
    }

    void close() {
        opening.stop();
        clicks.stop();
        last = fullScreen.windowedBounds();
        frame.dispose();
        onClosed.run();
    }

    private void tellInstead(Glyph glyph, Color color, String title, String text) {
        message.tell(glyph, color, title, text, false);
        showCard(MESSAGE);
    }

    /** That size in the present scale, as far as a part of the screen has room for more of it. */
    private static Dimension withinScreen(int width, int height, double part) {
        Rectangle screen = roomOnScreen();
        Dimension wanted = Theme.size(width, height);
        return new Dimension(
                Math.max(width, Math.min(wanted.width, (int) (screen.width * part))),
                Math.max(height, Math.min(wanted.height, (int) (screen.height * part))));
    }

    private static Rectangle roomOnScreen() {
        return GraphicsEnvironment.getLocalGraphicsEnvironment().getMaximumWindowBounds();
    }

    /** As large as the video, within a part of the screen. */
    private void fitWindow() {
        Rectangle screen = roomOnScreen();
        int mostWidth = (int) (screen.width * LARGEST_PART_OF_SCREEN);
        int mostHeight =
                (int) (screen.height * LARGEST_PART_OF_SCREEN) - bar.getPreferredSize().height;
        int width = Math.min(videoSize.width, mostWidth);
        int height = Math.min(videoSize.height, mostHeight);
        Rectangle place = VideoPane.fit(videoSize.width, videoSize.height, width, height);
        room.setPreferredSize(place.getSize());
        frame.pack();
        frame.setLocationRelativeTo(null);
    }

    /** Lets the player draw in the size that is shown, so that nothing is scaled twice. */
    private void requestFrames() {
        Dimension pixels = video.room();
        if (videoSize == null || pixels.width == 0 || pixels.height == 0) {
            return;
        }
        Rectangle place =
                VideoPane.fit(videoSize.width, videoSize.height, pixels.width, pixels.height);
        conductor.requestFrameSize(place.width, place.height);
    }

    /** At first, and where the controls hide: the picture itself has no use for keys. */
    private void giveFocusToPicture() {
        room.setFocusable(true);
        room.getAccessibleContext().setAccessibleName("Picture");
        // Which has the focus while a menu is open.
        frame.getRootPane().getAccessibleContext().setAccessibleName("Player");
        frame.setFocusTraversalPolicy(
                new LayoutFocusTraversalPolicy() {
                    @Override
                    protected boolean accept(Component component) {
                        return component == room
                                ? room.isShowing() && room.isEnabled()
                                : super.accept(component);
                    }
                });
    }

    private void listen() {
        frame.setDefaultCloseOperation(WindowConstants.DO_NOTHING_ON_CLOSE);
        frame.addWindowListener(
                new WindowAdapter() {
                    @Override
                    public void windowClosing(WindowEvent event) {
                        close();
                    }

                    @Override
                    public void windowIconified(WindowEvent event) {
                        conductor.setWatched(false);
                    }

                    @Override
                    public void windowDeiconified(WindowEvent event) {
                        conductor.setWatched(true);
                    }
                });
        room.addMouseListener(clicks);
        room.addMouseListener(menuOpener());
        room.addMouseWheelListener(this::onWheel);
    }

    private void onWheel(MouseWheelEvent event) {
        conductor.changeVolume(-event.getPreciseWheelRotation() * ControlBar.VOLUME_STEP);
    }

    private MouseAdapter menuOpener() {
        return new MouseAdapter() {
            @Override
            public void mousePressed(MouseEvent event) {
                if (SwingUtilities.isRightMouseButton(event)) {
                    ActionMenu.open(event.getComponent(), event.getX(), event.getY(), actions);
                }
            }
        };
    }
}
