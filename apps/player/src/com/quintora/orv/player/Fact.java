// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

/** Something that is known of a playback, with the name that people give it. */
public record Fact(String name, String value) {}
