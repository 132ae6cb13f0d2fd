package com.velt.android.orvane.lumetrix.desktop.editing;

/**
 * The brush of a stroke.
 *
 * @param radius its radius in photo pixels
 * @param core its core's radius in photo pixels
 */
public record Brush(int radius, int core) {}
