package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Editor;
import com.velt.android.orvane.lumetrix.desktop.editing.EditorListener;
import com.velt.android.orvane.lumetrix.desktop.editing.EditorState;
import com.velt.android.orvane.lumetrix.desktop.editing.Message;
import com.velt.android.orvane.lumetrix.desktop.editing.OpenedPhoto;
import com.velt.android.orvane.lumetrix.desktop.editing.Tool;
import com.velt.android.orvane.lumetrix.desktop.editing.ViewKind;
import java.awt.BorderLayout;
import java.awt.Dimension;
import java.awt.Rectangle;
import java.awt.event.WindowAdapter;
import java.awt.event.WindowEvent;
import java.nio.file.Path;
import java.util.concurrent.CompletableFuture;
import javax.swing.JFrame;
import javax.swing.SwingUtilities;
import javax.swing.Timer;

/** The window of the editing screen: its parts put together. */
final class ScreenFrame extends JFrame {
    private static final long serialVersionUID = 1;
    private static final String TITLE = "Select an object";
    private static final Dimension USUAL_SIZE = new Dimension(1280, 800);
    private static final Dimension SMALLEST_SIZE = new Dimension(960, 560);
    private static final int DASH_MILLIS = 400;
    private static final double ZOOM_STEP = 1.5;  // of the keys
    private static final int CORE_STEP = 5;       // percent

    private final transient ScreenModel model = new ScreenModel();
    private final transient Editor editor = new Editor(new Listener());
    private final transient Actions actions = new Actions(this::strokeUnderWay);
    private final transient FileCommands files;
    private final transient Questions questions;
    private final transient HeldKeys held;
    private final transient PointerInput pointer;
    private final PhotoCanvas canvas = new PhotoCanvas(model, editor);
    private final Toast toast = new Toast();
    private final transient WorkPanel work;
    private final transient Timer dashes = new Timer(DASH_MILLIS, tick -> editor.moveDashes());

    /** Makes the window, with dialogues that ask its user unless others are given. */
    ScreenFrame(FileChoice otherFiles, Questions otherQuestions) {
        super(TITLE);
        setName("editing screen");
        questions = otherQuestions == null ? new QuestionDialogs(this) : otherQuestions;
        files = new FileCommands(editor, model,
                otherFiles == null ? new FileDialogs(this) : otherFiles, questions);
        defineActs();
        StatusLine status = new StatusLine(model);
        held = new HeldKeys(canvas);
        pointer = new PointerInput(canvas, model, editor, held, status, this::tell);
        work = new WorkPanel(model, actions);
        layOut(status);
        actions.bindKeys(getRootPane());
        getRootPane().setTransferHandler(new FileDrop(files::use));
        Watcher watcher = new Watcher();
        addWindowListener(watcher);
        addWindowFocusListener(watcher);
        setDefaultCloseOperation(DO_NOTHING_ON_CLOSE);
        model.listen(this::refresh);
        held.watch();
        model.changed();
    }

    private void layOut(StatusLine status) {
        canvas.setLayout(new CanvasLayout());
        canvas.add(toast, CanvasLayout.BOTTOM);
        canvas.add(work, CanvasLayout.TOP);
        canvas.add(new EmptyScreen(model, actions), CanvasLayout.MIDDLE);
        setJMenuBar(new ScreenMenus(model).bar(actions));
        add(new OptionsBar(model, actions), BorderLayout.NORTH);
        add(new ToolBar(model, actions), BorderLayout.WEST);
        add(canvas, BorderLayout.CENTER);
        add(status, BorderLayout.SOUTH);
        setIconImages(Icons.ofProgram());
        setMinimumSize(SMALLEST_SIZE);
        Rectangle room = getGraphicsConfiguration().getBounds();
        setSize(Math.min(USUAL_SIZE.width, room.width), Math.min(USUAL_SIZE.height, room.height));
        setLocationRelativeTo(null);
    }

    private void defineActs() {
        actions.define(Act.OPEN_PHOTO, files::openPhoto);
        actions.define(Act.REPLAY, files::replayScript);
        actions.define(Act.LOAD_MASK, files::loadMask);
        actions.define(Act.SAVE_SCRIPT, files::saveScript);
        actions.define(Act.SAVE_MASK, files::saveMask);
        actions.define(Act.SAVE_CUT_OUT, files::saveCutOut);
        actions.define(Act.SAVE_VIEW, files::saveView);
        actions.define(Act.STOP, this::stop);
        actions.define(Act.CLOSE, this::closeWhenSaved);
        actions.define(Act.UNDO, editor::undo);
        actions.define(Act.REDO, editor::redo);
        actions.define(Act.CLEAR, editor::clear);
        actions.define(Act.INVERT, editor::invert);
        actions.define(Act.FILL, () -> editor.setFill(!model.state().fill()));
        ToolBar.TOOL_ACTS.forEach((tool, act) -> actions.define(act, () -> setTool(tool)));
        actions.define(Act.SMALLER, () -> model.change(m -> m.brushSettings().reduce()));
        actions.define(Act.LARGER, () -> model.change(m -> m.brushSettings().enlarge()));
        actions.define(Act.CORE_SMALLER, () -> growCore(-CORE_STEP));
        actions.define(Act.CORE_LARGER, () -> growCore(CORE_STEP));
        actions.define(Act.SAME_SIZE, this::switchSameSize);
        OptionsBar.VIEW_ACTS.forEach((kind, act) ->
                actions.define(act, () -> model.change(m -> m.setKind(kind))));
        actions.define(Act.NEXT_VIEW, this::showNextView);
        actions.define(Act.PHOTO_ALONE, () ->
                model.change(m -> m.setPhotoAlone(!m.photoAlone())));
        actions.define(Act.ZOOM_IN, () -> zoom(ZOOM_STEP));
        actions.define(Act.ZOOM_OUT, () -> zoom(1 / ZOOM_STEP));
        actions.define(Act.FIT, () -> model.change(m -> m.view().fit()));
        actions.define(Act.TRUE_PIXELS, () -> model.change(m ->
                m.view().showTruePixels(pointer.zoomX(), pointer.zoomY())));
        actions.define(Act.KEYS, () -> KeysDialog.show(this));
    }

    private void setTool(Tool tool) {
        model.change(m -> m.setTool(tool));
    }

    private void growCore(int percent) {
        var brush = model.brushSettings();
        model.change(m -> brush.setCorePercent(brush.corePercent() + percent));
    }

    private void switchSameSize() {
        var brush = model.brushSettings();
        model.change(m -> brush.setConstantOnScreen(!brush.constantOnScreen(), m.view().scale()));
    }

    private void showNextView() {
        ViewKind[] kinds = OptionsBar.VIEW_ACTS.keySet().toArray(ViewKind[]::new);
        int next = (model.chosenKind().ordinal() + 1) % kinds.length;
        model.change(m -> m.setKind(kinds[next]));
    }

    private void zoom(double factor) {
        model.change(m -> m.view().zoom(factor, pointer.zoomX(), pointer.zoomY()));
    }

    private boolean strokeUnderWay() {
        return pointer.strokeUnderWay();
    }

    private void stop() {
        if (strokeUnderWay()) {
            pointer.cut();
        } else {
            editor.stopReplay();
        }
    }

    /** Has the outline's dashes move as long as somebody can see them. */
    private void startOrStopDashes() {
        boolean seen = isActive() && isShowing() && (getExtendedState() & ICONIFIED) == 0
                && model.state().selectedPixels() > 0 && model.shownKind() == ViewKind.OUTLINE;
        if (!seen) {
            dashes.stop();
        } else if (!dashes.isRunning()) {
            dashes.start();
        }
    }

    private void refresh() {
        EditorState state = model.state();
        boolean photo = model.hasPhoto();
        boolean editable = photo && !model.replaying();
        actions.enable(Act.OPEN_PHOTO, !model.replaying());
        actions.enable(Act.REPLAY, !model.replaying());
        for (Act act : new Act[] {Act.LOAD_MASK, Act.SAVE_SCRIPT, Act.SAVE_MASK, Act.SAVE_CUT_OUT,
            Act.SAVE_VIEW, Act.INVERT, Act.FILL}) {
            actions.enable(act, editable);
        }
        actions.enable(Act.CLEAR, editable && state.selectedPixels() > 0);
        actions.enable(Act.UNDO, editable && state.canUndo());
        actions.enable(Act.REDO, editable && state.canRedo());
        actions.select(Act.FILL, state.fill());
        actions.select(Act.SAME_SIZE, model.brushSettings().constantOnScreen());
        actions.select(Act.PHOTO_ALONE, model.photoAlone());
        setTitle(titleFor(state));
        startOrStopDashes();
    }

    private static String titleFor(EditorState state) {
        OpenedPhoto photo = state.photo();
        if (photo == null) return TITLE;
        return (state.unsaved() ? "• " : "") + photo.name() + " — " + TITLE;
    }

    /** Opens a photo or replays a script. */
    void use(Path file) {
        files.use(file);
    }

    /** Returns what works on the photo. */
    Editor editor() {
        return editor;
    }

    /** Returns where the photo is shown. */
    PhotoCanvas canvas() {
        return canvas;
    }

    /** Returns what the parts of the window share. */
    ScreenModel model() {
        return model;
    }

    /** Closes the window once the selection is saved or nobody wants it. */
    void closeWhenSaved() {
        pointer.cut();
        editor.stopReplay();
        files.leaveSelection(this::close);
    }

    /**
     * Closes the window, whatever is not saved.
     *
     * @return is done once the editor is closed, which waits for files that are being saved
     */
    CompletableFuture<Void> close() {
        dashes.stop();
        toast.close();
        work.close();
        held.close();
        dispose();
        return CompletableFuture.runAsync(editor::close,
                closing -> new Thread(closing, "closing").start());
    }

    private final class Watcher extends WindowAdapter {
        @Override
        public void windowClosing(WindowEvent event) {
            closeWhenSaved();
        }

        @Override
        public void windowOpened(WindowEvent event) {
            canvas.requestFocusInWindow();
        }

        @Override
        public void windowActivated(WindowEvent event) {
            startOrStopDashes();
        }

        @Override
        public void windowDeactivated(WindowEvent event) {
            startOrStopDashes();
        }

        @Override
        public void windowIconified(WindowEvent event) {
            startOrStopDashes();
        }

        @Override
        public void windowLostFocus(WindowEvent event) {
            pointer.cut();
            held.forget();
        }
    }

    /** Hands over what the editor's threads tell. */
    private final class Listener implements EditorListener {
        @Override
        public void frameDrawn() {
            canvas.repaint();  // may be called by any thread, and many calls become one
        }

        @Override
        public void stateChanged(EditorState state) {
            SwingUtilities.invokeLater(() -> model.change(m -> m.setState(state)));
        }

        @Override
        public void said(Message message) {
            SwingUtilities.invokeLater(() -> tell(message));
        }
    }

    private void tell(Message message) {
        switch (message.kind()) {
            case HINT, DONE -> toast.show(message);
            case PROBLEM -> questions.tellProblem(message.text());
        }
    }
}
