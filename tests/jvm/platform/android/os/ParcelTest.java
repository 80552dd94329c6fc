// SPDX-License-Identifier: Apache-2.0
package android.os;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;

import java.util.Arrays;
import org.junit.jupiter.api.Test;

class ParcelTest {
    private static final String TEXT = "h\u00e9\ud83c\udfac";

    private final Parcel parcel = Parcel.obtain();

    private static Parcel parcelOf(byte... bytes) {
        Parcel parcel = Parcel.obtain();
        parcel.unmarshall(bytes, 0, bytes.length);
        return parcel;
    }

    @Test
    void nativeParcelsReadAndWriteTheSameBytes() {
        parcel.writeInt(Integer.MIN_VALUE);
        parcel.writeLong(0x0102030405060708L);
        parcel.writeFloat(0.1f);
        parcel.writeDouble(-0.2);
        parcel.writeString(TEXT);
        assertEquals(4 + 8 + 4 + 8 + 4 + 12, parcel.dataSize());
        assertArrayEquals(parcel.marshall(), PlatformNatives.rewriteParcel(parcel.marshall()));
    }

    @Test
    void readsBackWhatWasWritten() {
        parcel.writeInt(-7);
        parcel.writeLong(Long.MAX_VALUE);
        parcel.writeFloat(1.5f);
        parcel.writeDouble(2.5);
        parcel.writeString(TEXT);
        parcel.writeString(null);
        parcel.writeString("");
        parcel.writeByteArray(new byte[] {1, 2, 3, 4, 5});
        parcel.writeByteArray(null);
        parcel.setDataPosition(0);
        assertEquals(-7, parcel.readInt());
        assertEquals(Long.MAX_VALUE, parcel.readLong());
        assertEquals(1.5f, parcel.readFloat());
        assertEquals(2.5, parcel.readDouble());
        assertEquals(TEXT, parcel.readString());
        assertNull(parcel.readString());
        assertEquals("", parcel.readString());
        assertArrayEquals(new byte[] {1, 2, 3, 4, 5}, parcel.createByteArray());
        assertNull(parcel.createByteArray());
        assertEquals(0, parcel.dataAvail());
    }

    @Test
    void padsWithZerosAlsoOverOldContent() {
        Parcel old = parcelOf(new byte[] {9, 9, 9, 9, 9, 9, 9, 9});
        old.writeByteArray(new byte[] {1});
        byte[] bytes = old.marshall();
        assertArrayEquals(new byte[] {1, 0, 0, 0}, Arrays.copyOfRange(bytes, 4, 8));
    }

    @Test
    void aShortReadYieldsNothingAndStays() {
        Parcel three = parcelOf((byte) 1, (byte) 2, (byte) 3);
        assertEquals(0, three.readInt());
        assertEquals(0, three.readLong());
        assertEquals(0, three.readFloat());
        assertEquals(0, three.readDouble());
        assertNull(three.readString());
        assertNull(three.createByteArray());
        assertEquals(0, three.dataPosition());
    }

    @Test
    void aBrokenLengthYieldsNullAndStays() {
        for (int length : new int[] {-2, 3, Integer.MAX_VALUE}) {
            Parcel broken = Parcel.obtain();
            broken.writeInt(length);
            broken.writeInt(0);
            broken.setDataPosition(0);
            assertNull(broken.readString(), "length " + length);
            assertEquals(0, broken.dataPosition());
        }
    }

    @Test
    void growsAndIsCut() {
        for (int i = 0; i < 1000; i++) {
            parcel.writeInt(i);
        }
        assertEquals(4000, parcel.dataSize());
        parcel.setDataPosition(3996);
        assertEquals(999, parcel.readInt());
        parcel.setDataSize(4);
        assertEquals(4, parcel.dataPosition());
        parcel.setDataSize(8);
        assertEquals(0, parcel.readInt());
    }

    @Test
    void recycledParcelsAreEmpty() {
        parcel.writeInt(1);
        parcel.recycle();
        assertEquals(0, parcel.dataSize());
        assertEquals(0, parcel.dataPosition());
    }

    @Test
    void impossiblePositionsSizesAndRangesAreRefused() {
        parcel.writeInt(1);
        assertThrows(IllegalArgumentException.class, () -> parcel.setDataPosition(5));
        assertThrows(IllegalArgumentException.class, () -> parcel.setDataPosition(-1));
        assertThrows(IllegalArgumentException.class, () -> parcel.setDataSize(-1));
        assertThrows(
                IndexOutOfBoundsException.class, () -> parcel.unmarshall(new byte[4], 2, 3));
        assertEquals(4, parcel.dataSize());
    }
}
