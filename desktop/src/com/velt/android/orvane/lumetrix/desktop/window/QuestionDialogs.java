package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.Component;
import javax.swing.JOptionPane;

/** Swing's dialogues. */
final class QuestionDialogs implements Questions {
    private static final int LONGEST_LINE = 80;  // letters

    private final Component owner;

    QuestionDialogs(Component owner) {
        this.owner = owner;
    }

    @Override
    public Answer aboutUnsaved(String photo) {
        Object[] answers = {"Save", "Discard", "Cancel"};
        int chosen = JOptionPane.showOptionDialog(owner, "The selection on " + photo
                        + " is not saved. Shall it be saved as a stroke script?",
                "Not saved", JOptionPane.DEFAULT_OPTION, JOptionPane.WARNING_MESSAGE, null, answers,
                answers[0]);
        return switch (chosen) {
            case 0 -> Answer.SAVE;
            case 1 -> Answer.DISCARD;
            default -> Answer.CANCEL;
        };
    }

    @Override
    public void tellProblem(String text) {
        JOptionPane.showMessageDialog(owner, wrapped(text), "That did not work",
                JOptionPane.ERROR_MESSAGE);
    }

    /** Breaks long lines between words. */
    private static String wrapped(String text) {
        StringBuilder lines = new StringBuilder();
        int length = 0;
        for (String word : text.split(" ")) {
            if (length > 0 && length + word.length() >= LONGEST_LINE) {
                lines.append('\n');
                length = 0;
            } else if (length > 0) {
                lines.append(' ');
            }
            lines.append(word);
            length += word.length() + 1;
        }
        return lines.toString();
    }
}
