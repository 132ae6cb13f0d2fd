package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotEquals;

import com.velt.android.orvane.lumetrix.selection.Mode;
import java.util.List;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.EnumSource;

class ToolTest {
    private static List<Mode> modes(boolean opposite) {
        return Stream.of(Tool.values()).map(tool -> tool.mode(opposite)).toList();
    }

    @Test
    void toolsDoWhatTheirNamesSay() {
        assertEquals(List.of("Smart brush", "Smart eraser", "Brush", "Eraser", "Lasso"),
                Stream.of(Tool.values()).map(Tool::title).toList());
        assertEquals(List.of(Mode.GROW, Mode.SHRINK, Mode.PAINT, Mode.ERASE, Mode.LASSO_ADD),
                modes(false));
        assertEquals(List.of(Mode.SHRINK, Mode.GROW, Mode.ERASE, Mode.PAINT, Mode.LASSO_REMOVE),
                modes(true));
    }

    @ParameterizedTest
    @EnumSource
    void oppositeTakesAwayWhatTheToolAddsAndTheOtherWayRound(Tool tool) {
        assertNotEquals(tool.takesAway(false), tool.takesAway(true));
        assertEquals(tool == Tool.SMART_ERASER || tool == Tool.ERASER, tool.takesAway(false));
    }

    @Test
    void lassoHasNoSizeAndPlainBrushesHaveNoCore() {
        assertEquals(List.of(true, true, true, true, false),
                Stream.of(Tool.values()).map(Tool::hasSize).toList());
        assertEquals(List.of(true, true, false, false, false),
                Stream.of(Tool.values()).map(Tool::hasCore).toList());
    }
}
