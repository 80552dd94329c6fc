// SPDX-License-Identifier: Apache-2.0
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerState;
import java.io.IOException;
import java.io.RandomAccessFile;
import java.math.BigInteger;
import java.security.GeneralSecurityException;
import java.util.HexFormat;
import javax.crypto.Cipher;
import javax.crypto.spec.IvParameterSpec;
import javax.crypto.spec.SecretKeySpec;

/** Plays a file of 16 bytes IV and then AES-CTR, whose key it reads in hex from standard input. */
public final class PlayEncrypted implements MediaStreamSource {
    private static final int BLOCK = 16;
    private static final BigInteger COUNTERS = BigInteger.ONE.shiftLeft(8 * BLOCK);
    private final RandomAccessFile file;
    private final SecretKeySpec key;
    private final byte[] iv = new byte[BLOCK];
    private final Cipher cipher = Cipher.getInstance("AES/CTR/NoPadding");

    private PlayEncrypted(RandomAccessFile file, String key) throws Exception {
        this.file = file;
        this.key = new SecretKeySpec(HexFormat.of().parseHex(key.strip()), "AES");
        file.readFully(iv);
        seek(0);
    }

    @Override
    public int read(byte[] buffer, int length) throws IOException {
        int count = file.read(buffer, 0, length);
        if (count > 0) {
            System.arraycopy(cipher.update(buffer, 0, count), 0, buffer, 0, count);
        }
        return count;
    }

    @Override
    public void seek(long position) throws IOException {
        // Every block can be decrypted by itself: its counter is the IV plus the block's number.
        BigInteger counter = new BigInteger(1, iv).add(BigInteger.valueOf(position / BLOCK));
        byte[] start = HexFormat.of().parseHex(String.format("%032x", counter.mod(COUNTERS)));
        try {
            cipher.init(Cipher.DECRYPT_MODE, key, new IvParameterSpec(start));
        } catch (GeneralSecurityException e) {
            throw new IOException("the key must have 16, 24 or 32 bytes", e);
        }
        cipher.update(new byte[(int) (position % BLOCK)]);
        file.seek(BLOCK + position);
    }

    @Override
    public long size() throws IOException {
        return file.length() - BLOCK;
    }

    public static void main(String[] args) throws Exception {
        if (args.length != 1) {
            System.err.println("usage: PlayEncrypted FILE <KEY.hex");
            System.exit(2);
        }
        try (RandomAccessFile file = new RandomAccessFile(args[0], "r");
                MediaPlayer player = new OrvMediaPlayer()) {
            player.setDataSource(new PlayEncrypted(file, new String(System.in.readAllBytes())));
            player.prepareAndWait();
            player.start();
            while (player.getState() == PlayerState.STARTED) {
                Thread.sleep(100); // EventLog shows how to be called at the end instead.
            }
            System.out.println(player.getState());
        } catch (IOException | IllegalArgumentException e) {
            String advice = e instanceof MediaException m ? "; " + m.error().advice() : "";
            System.err.println(args[0] + ": " + e.getMessage() + advice);
            System.exit(1);
        }
    }
}
