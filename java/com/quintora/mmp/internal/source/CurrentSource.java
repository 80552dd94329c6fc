// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.source;

import com.quintora.mmp.internal.base.SharedFields;
import java.util.concurrent.atomic.AtomicReference;

/** What a player plays: its name, and the stream that feeds it if there is one. Thread-safe. */
public final class CurrentSource {
    private final SharedFields fields;
    private final AtomicReference<StreamAdapter> stream;
    private volatile String name = "";

    public CurrentSource(SharedFields fields) {
        this.fields = fields;
        stream = new AtomicReference<>(StreamAdapter.none(fields));
    }

    /** A path, a URL or words for another source; empty for none. */
    public String name() {
        return name;
    }

    public void setName(String newName) {
        name = newName;
    }

    /** An empty one where the player has no stream. */
    public StreamAdapter stream() {
        return stream.get();
    }

    public void use(StreamAdapter adapter) {
        stream.set(adapter);
    }

    /** Closes a stream, and uses it no more if it is the one in use. */
    public void drop(StreamAdapter adapter) {
        adapter.close();
        stream.compareAndSet(adapter, StreamAdapter.none(fields));
    }

    public void forget() {
        stream.getAndSet(StreamAdapter.none(fields)).close();
        fields.dropStreamBuffer();
        name = "";
    }
}
