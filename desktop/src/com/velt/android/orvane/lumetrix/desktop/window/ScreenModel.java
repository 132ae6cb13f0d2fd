package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Brush;
import com.velt.android.orvane.lumetrix.desktop.editing.BrushSettings;
import com.velt.android.orvane.lumetrix.desktop.editing.EditorState;
import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewModel;
import java.util.ArrayList;
import java.util.List;
import java.util.function.Consumer;

/**
 * What the parts of the window share: tool, brush, view, and what the editor told last.
 *
 * <p>Whoever changes something calls {@link #changed}; every part then shows what is new.
 */
final class ScreenModel {
    private final ViewModel view = new ViewModel();
    private final BrushSettings brush = new BrushSettings();
    private final List<Runnable> listeners = new ArrayList<>();
    private EditorState state = EditorState.EMPTY;
    private Tool tool = Tool.SMART_BRUSH;
    private ViewKind kind = ViewKind.OUTLINE;
    private boolean photoAlone;

    /** Has a part of the window told of every change. */
    void listen(Runnable listener) {
        listeners.add(listener);
    }

    /** Tells every part that something has changed. */
    void changed() {
        listeners.forEach(Runnable::run);
    }

    /** Changes something and tells every part. */
    void change(Consumer<ScreenModel> change) {
        change.accept(this);
        changed();
    }

    ViewModel view() {
        return view;
    }

    BrushSettings brushSettings() {
        return brush;
    }

    /** Returns the brush for a stroke at the present zoom. */
    Brush brush() {
        return brush.brush(view.scale());
    }

    EditorState state() {
        return state;
    }

    void setState(EditorState next) {
        state = next;
    }

    boolean hasPhoto() {
        return state.photo() != null;
    }

    /** Tells whether a script is played. */
    boolean replaying() {
        return state.workTotal() > 0;
    }

    Tool tool() {
        return tool;
    }

    void setTool(Tool next) {
        tool = next;
    }

    /** Returns the view chosen, also while the photo is shown alone. */
    ViewKind chosenKind() {
        return kind;
    }

    /** Returns the view that is shown. */
    ViewKind shownKind() {
        return photoAlone ? ViewKind.PHOTO : kind;
    }

    /** Chooses a view, and shows it also when the photo was shown alone. */
    void setKind(ViewKind next) {
        kind = next;
        photoAlone = false;
    }

    boolean photoAlone() {
        return photoAlone;
    }

    void setPhotoAlone(boolean alone) {
        photoAlone = alone;
    }

    /** Returns the screen pixels a photo pixel takes, in percent. */
    double zoomPercent() {
        return 100.0 / view.scale();
    }
}
