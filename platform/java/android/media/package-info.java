// SPDX-License-Identifier: Apache-2.0
/** Frames of a video for a program to read, as on a television. */
package android.media;
