package com.velt.android.orvane.lumetrix.desktop.editing;

/** What is seen of photo and selection. */
public enum ViewKind {
    /** The photo with a dashed line around the selection. */
    OUTLINE("Outline"),
    /** The selection in colour, the rest grey. */
    GREY_REST("Grey rest"),
    /** The selection grey, the rest in colour. */
    REVERSE("Reverse"),
    /** The selection white on black. */
    MASK("Mask"),
    /** The photo alone. */
    PHOTO("Photo");

    private final String title;

    ViewKind(String title) {
        this.title = title;
    }

    /** Returns the view's name for people. */
    public String title() {
        return title;
    }

    /**
     * Returns where in a photo pixel the library looks when it draws this view: outlined views
     * round positions to the nearest photo pixel, the others truncate.
     */
    float rounding() {
        return this == OUTLINE ? 0.5f : 0;
    }
}
