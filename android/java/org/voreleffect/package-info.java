/**
 * Text effects painted from coverage masks, the same bytes on every CPU. {@link org.voreleffect.Look},
 * {@link org.voreleffect.Painter} and {@link org.voreleffect.Picture} are the place to begin;
 * {@link org.voreleffect.VorelBitmaps} paints on bitmaps of Android, and
 * {@link org.voreleffect.VorelEffect} has the calls of the C++ classes one by one.
 */
package org.voreleffect;
