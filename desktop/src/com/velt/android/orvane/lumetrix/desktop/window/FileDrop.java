package com.velt.android.orvane.lumetrix.desktop.window;

import java.awt.datatransfer.DataFlavor;
import java.awt.datatransfer.UnsupportedFlavorException;
import java.io.File;
import java.io.IOException;
import java.nio.file.Path;
import java.util.List;
import java.util.function.Consumer;
import javax.swing.TransferHandler;

/** Takes a file that is dropped on the window; of several, the first. */
final class FileDrop extends TransferHandler {
    private static final long serialVersionUID = 1;

    private final transient Consumer<Path> taker;

    FileDrop(Consumer<Path> taker) {
        this.taker = taker;
    }

    @Override
    public boolean canImport(TransferSupport support) {
        return support.isDataFlavorSupported(DataFlavor.javaFileListFlavor);
    }

    @Override
    public boolean importData(TransferSupport support) {
        if (!canImport(support)) return false;
        try {
            List<?> files = (List<?>) support.getTransferable()
                    .getTransferData(DataFlavor.javaFileListFlavor);
            if (files.isEmpty()) return false;
            taker.accept(((File) files.get(0)).toPath());
            return true;
        } catch (UnsupportedFlavorException | IOException e) {
            return false;  // the one who dropped it has taken it back
        }
    }
}
