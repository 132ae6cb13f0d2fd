package com.velt.android.orvane.lumetrix.desktop.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.EnumSet;
import java.util.HashMap;
import java.util.HashSet;
import java.util.List;
import java.util.Map;
import java.util.Set;
import javax.swing.KeyStroke;
import org.junit.jupiter.api.Test;

class ActTest {
    @Test
    void noKeyMeansTwoThings() {
        Map<KeyStroke, Act> owners = new HashMap<>();
        for (Act act : Act.values()) {
            for (KeyStroke key : act.keys()) {
                assertNotNull(key, act + " has a key that Swing cannot read");
                Act other = owners.put(key, act);
                assertTrue(other == null, key + " is the key of " + act + " and " + other);
            }
        }
    }

    @Test
    void everyActHasAKeyATitleOfItsOwnAndASentence() {
        Set<String> titles = new HashSet<>();
        for (Act act : Act.values()) {
            assertFalse(act.keys().isEmpty(), act.name());
            assertTrue(titles.add(act.title()), act.name());
            assertTrue(act.help().endsWith("."), act.help());
        }
    }

    @Test
    void thePageAboutTheScreenNamesEveryKey() throws IOException {
        Path page = Path.of(System.getProperty("desktop.folder"), "..", "docs", "screen.md");
        String text = Files.readString(page);
        for (Act act : Act.values()) {
            for (String key : act.keysInWords().split(" or ")) {
                assertTrue(text.contains("`" + key + "`"), act + ": " + key);
            }
        }
    }

    @Test
    void noBareKeyTypesACharacterThatIsBoundAsTyped() {
        Set<Integer> pressed = new HashSet<>();
        for (Act act : Act.values()) {
            for (KeyStroke key : act.keys()) {
                if (key.getModifiers() == 0) pressed.add(key.getKeyCode());
            }
        }
        for (Act act : Act.values()) {
            for (KeyStroke key : act.keys()) {
                boolean typed = key.getKeyCode() == 0;
                assertFalse(typed && pressed.contains((int) key.getKeyChar()), act.name());
            }
        }
    }

    @Test
    void everyActIsInOneMenu() {
        Set<Act> found = EnumSet.noneOf(Act.class);
        for (Act.Group group : Act.Group.values()) {
            for (Act act : group.acts()) assertTrue(found.add(act), act.name());
        }
        assertEquals(EnumSet.allOf(Act.class), found);
    }

    @Test
    void everyToolAndEveryViewHasAnAct() {
        assertEquals(EnumSet.allOf(Tool.class), ToolBar.TOOL_ACTS.keySet());
        assertEquals(EnumSet.complementOf(EnumSet.of(ViewKind.PHOTO)),
                OptionsBar.VIEW_ACTS.keySet());
    }

    @Test
    void noMenuOpensByTheKeyOfAToolWithAlt() {
        for (Act tool : ToolBar.TOOL_ACTS.values()) {
            for (Act.Group group : Act.Group.values()) {
                assertNotEquals(tool.keys().get(0).getKeyCode(), group.letter(), tool.name());
            }
        }
    }

    @Test
    void tooltipsNameTheKeys() {
        assertTrue(Act.BRUSH.tooltip().contains("<b>Brush</b>&ensp;B<br>Selects all"),
                Act.BRUSH.tooltip());
        assertTrue(Act.SMALLER.tooltip().contains("&ensp;[<br>"), Act.SMALLER.tooltip());
        assertEquals("Ctrl+Shift+Z or Ctrl+Y", Act.REDO.keysInWords());
    }

    @Test
    void theListOfKeysNamesEveryAct() {
        List<KeysDialog.Row> rows = Arrays.stream(Act.Group.values())
                .flatMap(group -> KeysDialog.rows(group).stream()).toList();

        assertEquals(Act.values().length, rows.size());
        assertTrue(rows.contains(new KeysDialog.Row("Ctrl+O", "Open photo",
                "Opens a JPEG or PNG file.")));
        for (Act act : Act.values()) {
            assertTrue(rows.stream().anyMatch(row -> row.keys().equals(act.keysInWords())
                    && row.help().equals(act.help())), act.name());
        }
    }
}
