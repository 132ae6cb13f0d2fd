package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Component;
import java.awt.Container;
import java.awt.event.HierarchyEvent;
import java.io.File;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Optional;
import javax.swing.JFileChooser;
import javax.swing.JOptionPane;
import javax.swing.JTextField;
import javax.swing.SwingUtilities;
import javax.swing.UIManager;
import javax.swing.filechooser.FileNameExtensionFilter;

/** Swing's file dialogues, which begin in the folder that was used last. */
final class FileDialogs implements FileChoice {
    private final Component owner;
    private File folder = new File("").getAbsoluteFile();

    FileDialogs(Component owner) {
        this.owner = owner;
    }

    @Override
    public Optional<Path> toOpen(String title, FileType type) {
        JFileChooser chooser = chooser(title, type, new JFileChooser(folder));
        return answer(chooser, chooser.showOpenDialog(owner));
    }

    @Override
    public Optional<Path> toSave(String title, FileType type, String suggestion) {
        JFileChooser chooser = chooser(title, type, SavingChooser.in(folder, type));
        chooser.setSelectedFile(new File(folder, suggestion));
        return answer(chooser, chooser.showSaveDialog(owner));
    }

    @Override
    public void used(Path file) {
        Path parent = file.toAbsolutePath().getParent();
        if (parent != null && Files.isDirectory(parent)) folder = parent.toFile();
    }

    private static JFileChooser chooser(String title, FileType type, JFileChooser chooser) {
        chooser.setName("files");
        chooser.setDialogTitle(title);
        chooser.setFileFilter(new FileNameExtensionFilter(type.title(),
                type.extensions().toArray(String[]::new)));
        chooser.addHierarchyListener(event -> {
            boolean changed = (event.getChangeFlags() & HierarchyEvent.SHOWING_CHANGED) != 0;
            if (changed && chooser.isShowing()) {
                SwingUtilities.invokeLater(() -> selectName(chooser));
            }
        });
        return chooser;
    }

    /** Has typing replace the name in the first text field, but for its extension. */
    private static void selectName(Container parent) {
        for (Component child : parent.getComponents()) {
            if (child instanceof JTextField field) {
                field.requestFocusInWindow();
                int dot = field.getText().lastIndexOf('.');
                field.select(0, dot < 0 ? field.getText().length() : dot);
                return;
            }
            if (child instanceof Container container) selectName(container);
        }
    }

    private Optional<Path> answer(JFileChooser chooser, int result) {
        if (result != JFileChooser.APPROVE_OPTION) return Optional.empty();
        Path file = chooser.getSelectedFile().toPath();
        used(file);
        return Optional.of(file);
    }

    /** Adds the extension, and asks before it replaces a file. */
    private static final class SavingChooser extends JFileChooser {
        private static final long serialVersionUID = 1;
        private static final String FOLDER_LABEL = "FileChooser.lookInLabelText";

        private final FileType type;

        private SavingChooser(File folder, FileType type) {
            super(folder);
            this.type = type;
        }

        /** Nimbus takes the label of opening, and takes it when the chooser is made. */
        static SavingChooser in(File folder, FileType type) {
            UIManager.put(FOLDER_LABEL, UIManager.getString("FileChooser.saveInLabelText"));
            try {
                return new SavingChooser(folder, type);
            } finally {
                UIManager.put(FOLDER_LABEL, null);  // the usual one again
            }
        }

        @Override
        public void approveSelection() {
            Path file = type.withExtension(getSelectedFile().toPath());
            setSelectedFile(file.toFile());
            if (!Files.exists(file) || mayReplace(file)) super.approveSelection();
        }

        private boolean mayReplace(Path file) {
            Object[] answers = {"Replace", "Cancel"};
            return JOptionPane.showOptionDialog(this, file.getFileName()
                            + " exists already. Shall it be replaced?",
                    "Replace file", JOptionPane.DEFAULT_OPTION, JOptionPane.WARNING_MESSAGE, null,
                    answers, answers[1]) == 0;
        }
    }
}
