// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.Component;
import java.awt.Container;
import java.awt.Robot;
import java.awt.Window;
import java.awt.event.InputEvent;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Set;
import javax.accessibility.Accessible;
import javax.accessibility.AccessibleContext;
import javax.accessibility.AccessibleRole;
import javax.swing.AbstractButton;
import javax.swing.JList;
import javax.swing.JMenu;
import javax.swing.JMenuItem;
import javax.swing.JPasswordField;
import javax.swing.JTextArea;
import javax.swing.JTextField;
import javax.swing.LayoutFocusTraversalPolicy;
import javax.swing.MenuElement;
import javax.swing.MenuSelectionManager;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** What a screen reader says of all that the keyboard reaches: a name, and what it is. */
class AccessibleNamesWindowTest extends WindowFixture {
    /** Those that say nothing of what a component is for. */
    private static final Set<AccessibleRole> EMPTY_ROLES =
            Set.of(
                    AccessibleRole.UNKNOWN,
                    AccessibleRole.AWT_COMPONENT,
                    AccessibleRole.SWING_COMPONENT,
                    AccessibleRole.PANEL,
                    AccessibleRole.FILLER);

    @TempDir Path folder;

    @Test
    void thePictureAndItsBar() throws Exception {
        openPlaying(Media.path("silent.mkv"));
        assertAllSpeak(NoticePane.class, "Picture");
        assertAllSpeak(LevelBar.class, "Position");
        assertAllSpeak(FlatButton.class, "Next one (N)");
    }

    @Test
    void thePlaylistAndItsRows() throws Exception {
        openPlaying(Media.path("silent.mkv"));
        press("L");
        assertAllSpeak(JList.class, "Playlist");
        JList<?> list = find(JList.class, "Playlist");
        assertEquals(List.of("silent.mkv", "long.mkv"), onWindow(() -> namesOfRows(list)));
    }

    @Test
    void thePanelsBesideThePicture() throws Exception {
        openPlaying();
        press("T");
        assertAllSpeak(ChoiceButton.class, "Colour of letters: Yellow");
        press("I");
        assertAllSpeak(JTextArea.class, "Information");
        press("G");
        assertAllSpeak(JTextArea.class, "Lines of the log");
        assertAllSpeak(JTextField.class, "Text to look for in the log");
        press("ESCAPE");
        press("shift L");
        assertAllSpeak(JPasswordField.class, "PIN");
    }

    @Test
    void theListOfKeys() throws Exception {
        openPlaying();
        press("H");
        assertAllSpeak(Help.class, "Keyboard shortcuts");
    }

    @Test
    void theMenuOfThePicture() throws Exception {
        openPlaying();
        pointAt(find(NoticePane.class, "Picture"), 0.1, 0.1);
        Robot mouse = robot();
        mouse.mousePress(InputEvent.BUTTON3_DOWN_MASK);
        mouse.mouseRelease(InputEvent.BUTTON3_DOWN_MASK);
        Wait.until("the menu shows", () -> onWindow(ChoiceMenu::isOpen));
        assertAllSpeak(JMenu.class, "Playback");
        MenuElement menu =
                onWindow(() -> MenuSelectionManager.defaultManager().getSelectedPath()[0]);
        for (MenuElement row : menu.getSubElements()) {
            JMenu group = (JMenu) row;
            JMenuItem first = group.getItem(0);
            onWindow(() -> {
                MenuSelectionManager.defaultManager()
                        .setSelectedPath(
                                new MenuElement[] {menu, group, group.getPopupMenu(), first});
                return null;
            });
            assertAllSpeak(JMenuItem.class, first.getText());
        }
    }

    @Test
    void theMenuOfChoices() throws Exception {
        open("tracks.mkv", "--loop", "--no-gpu");
        awaitButton("Pause (Space)");
        press("S");
        assertAllSpeak(JMenuItem.class, "Off");
    }

    @Test
    void theMessageInThePicturesPlace() throws Exception {
        openSource(folder.resolve("none.mkv").toString());
        awaitButton("Open other files (O)");
        assertAllSpeak(FlatButton.class, "Open other files (O)");
    }

    private void openPlaying(String... others) throws Exception {
        String[] options = new String[others.length + 1];
        System.arraycopy(others, 0, options, 0, others.length);
        options[others.length] = "--no-gpu";
        open("long.mkv", options);
        awaitButton("Pause (Space)");
    }

    /** All that shows, once there is a component of that kind called so. */
    private static void assertAllSpeak(Class<? extends Component> kind, String name)
            throws Exception {
        Wait.until(
                "there is " + name,
                () -> onWindow(
                        () -> showing().stream()
                                .anyMatch(shown -> kind.isInstance(shown)
                                        && name.equals(nameOf(shown)))));
        onWindow(() -> {
            List<Component> reached =
                    showing().stream().filter(AccessibleNamesWindowTest::isReached).toList();
            assertTrue(reached.size() > 5, reached::toString);
            List<String> mute = reached.stream().filter(AccessibleNamesWindowTest::isMute)
                    .map(AccessibleNamesWindowTest::describe).toList();
            assertEquals(List.of(), mute, "no name, or no role");
            return null;
        });
    }

    private static List<Component> showing() {
        List<Component> found = new ArrayList<>();
        for (Window window : Window.getWindows()) {
            addShowing(window, found);
        }
        return found;
    }

    private static void addShowing(Container parent, List<Component> found) {
        for (Component child : parent.getComponents()) {
            if (child.isShowing()) {
                found.add(child);
                if (child instanceof Container box) {
                    addShowing(box, found);
                }
            }
        }
    }

    /** By Tab, by an arrow in a menu, or because a panel hands it the focus. */
    private static boolean isReached(Component component) {
        return Reach.INSTANCE.accept(component)
                || component.isFocusOwner()
                || component instanceof AbstractButton
                || component instanceof NoticePane;
    }

    private static boolean isMute(Component component) {
        String name = nameOf(component);
        return name == null
                || name.isBlank()
                || EMPTY_ROLES.contains(component.getAccessibleContext().getAccessibleRole());
    }

    private static String describe(Component component) {
        AccessibleRole role = component.getAccessibleContext().getAccessibleRole();
        return component.getClass().getName() + " " + nameOf(component) + ", " + role;
    }

    private static String nameOf(Component component) {
        AccessibleContext context = component.getAccessibleContext();
        return context == null ? null : context.getAccessibleName();
    }

    private static List<String> namesOfRows(JList<?> list) {
        List<String> names = new ArrayList<>();
        for (int row = 0; row < list.getModel().getSize(); row++) {
            Accessible child = list.getAccessibleContext().getAccessibleChild(row);
            assertNotNull(child);
            names.add(child.getAccessibleContext().getAccessibleName());
        }
        return names;
    }

    /** What Swing gives the focus to. */
    private static final class Reach extends LayoutFocusTraversalPolicy {
        static final Reach INSTANCE = new Reach();

        private static final long serialVersionUID = 1;

        @Override
        protected boolean accept(Component component) {
            return super.accept(component);
        }
    }
}
