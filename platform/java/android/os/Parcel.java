// SPDX-License-Identifier: Apache-2.0
package android.os;

import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.util.Arrays;

/**
 * A growing block of values in the format of native parcels: native byte order, every value padded
 * with zeros to a multiple of 4 bytes. One position serves reading and writing. A read past the end
 * yields 0 or null and leaves the position. Not thread-safe; nothing blocks.
 */
public final class Parcel {
    private static final int INITIAL_CAPACITY = 64;
    private static final int NULL_LENGTH = -1;

    private ByteBuffer mData = allocate(INITIAL_CAPACITY);
    private int mSize;
    private int mPosition;

    private Parcel() {}

    /**
     * Makes a parcel.
     *
     * @return an empty one
     */
    public static Parcel obtain() {
        return new Parcel();
    }

    /** Empties the parcel. Do not use it afterwards. */
    public void recycle() {
        mData = allocate(INITIAL_CAPACITY);
        mSize = 0;
        mPosition = 0;
    }

    /**
     * The size.
     *
     * @return bytes in the parcel
     */
    public int dataSize() {
        return mSize;
    }

    /**
     * What is left to read.
     *
     * @return bytes from the position to the end
     */
    public int dataAvail() {
        return mSize - mPosition;
    }

    /**
     * The position.
     *
     * @return where the next value is read or written, in bytes from the start
     */
    public int dataPosition() {
        return mPosition;
    }

    /**
     * Moves the position.
     *
     * @param pos bytes from the start
     * @throws IllegalArgumentException for one outside 0 to {@link #dataSize()}
     */
    public void setDataPosition(int pos) {
        if (pos < 0 || pos > mSize) {
            throw new IllegalArgumentException("position " + pos + " outside 0.." + mSize);
        }
        mPosition = pos;
    }

    /**
     * Cuts the parcel, or extends it with zeros; a position behind the new end moves there.
     *
     * @param size bytes
     * @throws IllegalArgumentException for a negative size
     */
    public void setDataSize(int size) {
        if (size < 0) {
            throw new IllegalArgumentException("size " + size);
        }
        ensureCapacity(size);
        if (size < mSize) {
            Arrays.fill(mData.array(), size, mSize, (byte) 0);
        }
        mSize = size;
        mPosition = Math.min(mPosition, size);
    }

    /**
     * Copies the whole content.
     *
     * @return bytes for {@link #unmarshall}
     */
    public byte[] marshall() {
        return Arrays.copyOf(mData.array(), mSize);
    }

    /**
     * Replaces the whole content and puts the position at its start.
     *
     * @param data holds the new content
     * @param offset its first byte there
     * @param length bytes
     * @throws IndexOutOfBoundsException for a range outside the array
     */
    public void unmarshall(byte[] data, int offset, int length) {
        ByteBuffer source = ByteBuffer.wrap(data, offset, length);
        mData = allocate(Math.max(length, INITIAL_CAPACITY));
        mData.put(source);
        mSize = length;
        mPosition = 0;
    }

    /**
     * Writes 4 bytes.
     *
     * @param value any
     */
    public void writeInt(int value) {
        int begin = advanceToWrite(Integer.BYTES);
        mData.putInt(begin, value);
    }

    /**
     * Writes 8 bytes.
     *
     * @param value any
     */
    public void writeLong(long value) {
        int begin = advanceToWrite(Long.BYTES);
        mData.putLong(begin, value);
    }

    /**
     * Writes 4 bytes.
     *
     * @param value any
     */
    public void writeFloat(float value) {
        int begin = advanceToWrite(Float.BYTES);
        mData.putFloat(begin, value);
    }

    /**
     * Writes 8 bytes.
     *
     * @param value any
     */
    public void writeDouble(double value) {
        int begin = advanceToWrite(Double.BYTES);
        mData.putDouble(begin, value);
    }

    /**
     * Writes the length in UTF-16 units, the units and a zero unit; the length -1 for null.
     *
     * @param text may be null
     */
    public void writeString(String text) {
        if (text == null) {
            writeInt(NULL_LENGTH);
            return;
        }
        int length = text.length();
        writeInt(length);
        int begin = advanceToWrite(Math.multiplyExact(length + 1, Character.BYTES));
        for (int i = 0; i < length; i++) {
            mData.putChar(begin + i * Character.BYTES, text.charAt(i));
        }
        mData.putChar(begin + length * Character.BYTES, '\0');
    }

    /**
     * Writes the length in bytes and the bytes; the length -1 for null.
     *
     * @param bytes may be null
     */
    public void writeByteArray(byte[] bytes) {
        if (bytes == null) {
            writeInt(NULL_LENGTH);
            return;
        }
        writeInt(bytes.length);
        int begin = advanceToWrite(bytes.length);
        System.arraycopy(bytes, 0, mData.array(), begin, bytes.length);
    }

    /**
     * Reads what {@link #writeInt} wrote.
     *
     * @return 0 when fewer than 4 bytes are left
     */
    public int readInt() {
        return has(Integer.BYTES) ? mData.getInt(advanceToRead(Integer.BYTES)) : 0;
    }

    /**
     * Reads what {@link #writeLong} wrote.
     *
     * @return 0 when fewer than 8 bytes are left
     */
    public long readLong() {
        return has(Long.BYTES) ? mData.getLong(advanceToRead(Long.BYTES)) : 0;
    }

    /**
     * Reads what {@link #writeFloat} wrote.
     *
     * @return 0 when fewer than 4 bytes are left
     */
    public float readFloat() {
        return has(Float.BYTES) ? mData.getFloat(advanceToRead(Float.BYTES)) : 0;
    }

    /**
     * Reads what {@link #writeDouble} wrote.
     *
     * @return 0 when fewer than 8 bytes are left
     */
    public double readDouble() {
        return has(Double.BYTES) ? mData.getDouble(advanceToRead(Double.BYTES)) : 0;
    }

    /**
     * Reads what {@link #writeString} wrote.
     *
     * @return null for a null that was written and for a broken length
     */
    public String readString() {
        int start = mPosition;
        int length = readLength();
        // One zero unit more than the text.
        if (length < 0 || !has(((long) length + 1) * Character.BYTES)) {
            return nullAt(start, length);
        }
        int begin = advanceToRead((length + 1) * Character.BYTES);
        char[] units = new char[length];
        for (int i = 0; i < length; i++) {
            units[i] = mData.getChar(begin + i * Character.BYTES);
        }
        return new String(units);
    }

    /**
     * Reads what {@link #writeByteArray} wrote.
     *
     * @return null for a null that was written and for a broken length
     */
    public byte[] createByteArray() {
        int start = mPosition;
        int length = readLength();
        if (length < 0 || !has(length)) {
            return nullAt(start, length);
        }
        int begin = advanceToRead(length);
        return Arrays.copyOfRange(mData.array(), begin, begin + length);
    }

    private static ByteBuffer allocate(int capacity) {
        return ByteBuffer.allocate(capacity).order(ByteOrder.nativeOrder());
    }

    private boolean has(long length) {
        return length <= dataAvail();
    }

    // Anything but a length that stands there is below -1.
    private int readLength() {
        return has(Integer.BYTES) ? readInt() : Integer.MIN_VALUE;
    }

    // Null was written, or the value is broken: then the position goes back.
    private <T> T nullAt(int start, int length) {
        if (length != NULL_LENGTH) {
            mPosition = start;
        }
        return null;
    }

    private static int padded(int length) {
        return Math.addExact(length, 3) & ~3;
    }

    private int advanceToRead(int length) {
        int begin = mPosition;
        // The last value of a parcel set from outside may lack its padding.
        mPosition = (int) Math.min((long) begin + padded(length), mSize);
        return begin;
    }

    // May replace mData: take the position first, then write.
    private int advanceToWrite(int length) {
        int begin = mPosition;
        int end = Math.addExact(begin, padded(length));
        ensureCapacity(end);
        Arrays.fill(mData.array(), begin + length, end, (byte) 0);
        mSize = Math.max(mSize, end);
        mPosition = end;
        return begin;
    }

    private void ensureCapacity(int size) {
        if (size > mData.capacity()) {
            int capacity = (int) Math.min(Integer.MAX_VALUE - 8L, Math.max(size, 2L * mSize));
            byte[] grown = Arrays.copyOf(mData.array(), capacity);
            mData = ByteBuffer.wrap(grown).order(ByteOrder.nativeOrder());
        }
    }
}
