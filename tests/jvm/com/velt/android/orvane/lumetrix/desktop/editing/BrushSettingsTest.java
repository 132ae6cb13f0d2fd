package com.velt.android.orvane.lumetrix.desktop.editing;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import org.junit.jupiter.api.Test;

class BrushSettingsTest {
    private final BrushSettings settings = new BrushSettings();

    @Test
    void sizesBeyondTheLimitsBecomeTheNearest() {
        settings.setSize(-4);
        assertEquals(BrushSettings.SMALLEST_SIZE, settings.size());
        settings.setSize(100_000);
        assertEquals(BrushSettings.LARGEST_SIZE, settings.size());
    }

    @Test
    void enlargingMakesLargerUpToTheLimit() {
        for (int size = 1; size < BrushSettings.LARGEST_SIZE; ++size) {
            settings.setSize(size);
            settings.enlarge();
            assertTrue(settings.size() > size, "size " + size);
        }
        settings.enlarge();
        assertEquals(BrushSettings.LARGEST_SIZE, settings.size());
    }

    @Test
    void reducingMakesSmallerDownToTheLimit() {
        for (int size = BrushSettings.LARGEST_SIZE; size > 1; --size) {
            settings.setSize(size);
            settings.reduce();
            assertTrue(settings.size() < size, "size " + size);
        }
        settings.reduce();
        assertEquals(BrushSettings.SMALLEST_SIZE, settings.size());
    }

    @Test
    void reducingTakesBackWhatEnlargingDid() {
        for (int size = 1; size <= BrushSettings.LARGEST_SIZE * 7 / 8; ++size) {
            settings.setSize(size);
            settings.enlarge();
            settings.reduce();
            assertEquals(size, settings.size());
        }
    }

    @Test
    void coreIsAShareOfTheRadius() {
        settings.setSize(50);
        settings.setCorePercent(30);
        assertEquals(new Brush(50, 15), settings.brush(1));
        settings.setSize(100);
        assertEquals(new Brush(100, 30), settings.brush(1));
    }

    @Test
    void coreSharesBeyondTheLimitsBecomeTheNearest() {
        settings.setCorePercent(-1);
        assertEquals(0, settings.corePercent());
        settings.setCorePercent(100);
        assertEquals(BrushSettings.LARGEST_CORE_PERCENT, settings.corePercent());
    }

    @Test
    void brushKeepsItsSizeOnThePhotoOverZooms() {
        assertFalse(settings.constantOnScreen());
        settings.setSize(40);
        assertEquals(40, settings.brush(0.1f).radius());
        assertEquals(40, settings.brush(9).radius());
    }

    @Test
    void constantBrushKeepsItsSizeOnTheScreenOverZooms() {
        settings.setConstantOnScreen(true, 1);
        settings.setSize(40);
        assertEquals(80, settings.brush(2).radius());
        assertEquals(20, settings.brush(0.5f).radius());
        assertEquals(40, settings.size());
    }

    @Test
    void constantBrushKeepsToTheLibrarysLimits() {
        settings.setConstantOnScreen(true, 1);
        settings.setSize(BrushSettings.LARGEST_SIZE);
        assertEquals(SelectionSession.LARGEST_RADIUS, settings.brush(100).radius());
        assertEquals(1, settings.brush(1f / 65536).radius());
    }

    @Test
    void switchingToConstantAndBackKeepsTheBrushOnThePhoto() {
        for (float scale : new float[] {0.5f, 1, 2, 3.3f}) {
            settings.setSize(60);
            settings.setConstantOnScreen(true, scale);
            assertTrue(settings.constantOnScreen());
            assertEquals(60, settings.brush(scale).radius(), scale / 2);
            settings.setConstantOnScreen(false, scale);
            assertEquals(60, settings.brush(scale).radius(), scale / 2);
        }
    }

    @Test
    void switchingToWhatItIsChangesNothing() {
        settings.setSize(60);
        settings.setConstantOnScreen(false, 2);
        assertEquals(60, settings.size());
    }
}
