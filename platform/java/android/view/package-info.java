// SPDX-License-Identifier: Apache-2.0
/** What a player draws on, as on a television but for {@link android.view.SurfaceView}. */
package android.view;
