package com.velt.android.orvane.lumetrix.desktop.window;

import com.velt.android.orvane.lumetrix.desktop.editing.Editor;
import java.nio.file.Path;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;
import java.util.function.Function;
import javax.swing.SwingUtilities;

/** Opening and saving, with the questions that belong to them. */
final class FileCommands {
    private final Editor editor;
    private final ScreenModel model;
    private final FileChoice files;
    private final Questions questions;
    private boolean leaving;  // somebody is about to be asked about unsaved work

    FileCommands(Editor editor, ScreenModel model, FileChoice files, Questions questions) {
        this.editor = editor;
        this.model = model;
        this.files = files;
        this.questions = questions;
    }

    void openPhoto() {
        leaveSelection(() -> files.toOpen("Open photo", FileType.PHOTO).ifPresent(editor::open));
    }

    void replayScript() {
        leaveSelection(() ->
                files.toOpen("Replay script", FileType.SCRIPT).ifPresent(editor::replay));
    }

    /** Opens a photo or replays a script, as its extension says. */
    void use(Path file) {
        if (model.replaying()) {
            editor.open(file);  // it says why not
            return;
        }
        leaveSelection(() -> {
            files.used(file);
            if (FileType.SCRIPT.fits(file)) {
                editor.replay(file);
            } else {
                editor.open(file);
            }
        });
    }

    void loadMask() {
        files.toOpen("Load mask", FileType.PHOTO).ifPresent(editor::loadMask);
    }

    void saveScript() {
        save("Save script", FileType.SCRIPT, "", editor::saveScript);
    }

    void saveMask() {
        save("Save mask", FileType.PICTURE, "-mask", editor::saveMask);
    }

    void saveCutOut() {
        save("Save cut-out", FileType.PICTURE, "-cut-out", editor::saveCutOut);
    }

    void saveView() {
        save("Save view", FileType.PICTURE, "-view", editor::saveView);
    }

    /** Returns whether it is saved in the end. */
    private CompletableFuture<Boolean> save(String title, FileType type, String suffix,
            Function<Path, CompletableFuture<Boolean>> saving) {
        String photo = model.state().photo().name().replaceFirst("\\.[^.]+$", "");
        Optional<Path> file = files.toSave(title, type,
                photo + suffix + "." + type.extensions().get(0));
        return file.map(saving).orElse(CompletableFuture.completedFuture(false));
    }

    /**
     * Does what leaves the selection, once it is saved or nobody wants it. The editor is asked, for
     * it may still be at work on the last stroke.
     */
    void leaveSelection(Runnable next) {
        if (leaving) return;
        leaving = true;
        editor.unsaved().thenAccept(unsaved -> SwingUtilities.invokeLater(() -> {
            try {
                if (unsaved) {
                    askAbout(next);
                } else {
                    next.run();
                }
            } finally {
                leaving = false;
            }
        }));
    }

    private void askAbout(Runnable next) {
        switch (questions.aboutUnsaved(model.state().photo().name())) {
            case SAVE -> save("Save script", FileType.SCRIPT, "", editor::saveScript)
                    .thenAccept(saved -> {
                        // There may be another stroke by then.
                        if (saved) SwingUtilities.invokeLater(() -> leaveSelection(next));
                    });
            case DISCARD -> next.run();
            case CANCEL -> {}
        }
    }
}
