// SPDX-License-Identifier: Apache-2.0
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerListener;
import java.io.IOException;
import java.io.InputStream;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ExecutionException;
import java.util.zip.ZipEntry;
import java.util.zip.ZipFile;

/**
 * Plays the sound of an entry of a ZIP file, stored or deflated. Seeks forward read on; seeks back
 * open the entry anew and read up to there, as nothing deflated can be entered in its middle.
 */
public final class PlayFromZip implements MediaStreamSource {
    private final ZipFile zip;
    private final ZipEntry entry;
    private InputStream bytes;
    private long position;

    private PlayFromZip(ZipFile zip, ZipEntry entry) throws IOException {
        this.zip = zip;
        this.entry = entry;
        bytes = zip.getInputStream(entry);
    }

    @Override
    public int read(byte[] buffer, int length) throws IOException {
        int count = bytes.read(buffer, 0, length);
        position += Math.max(0, count);
        return count;
    }

    @Override
    public void seek(long target) throws IOException {
        if (target < position) {
            bytes.close();
            bytes = zip.getInputStream(entry);
            position = 0;
        }
        bytes.skipNBytes(target - position);
        position = target;
    }

    @Override
    public long size() {
        return entry.getSize();
    }

    public static void main(String[] args) throws Exception {
        if (args.length != 2) {
            System.err.println("usage: PlayFromZip ARCHIVE.zip ENTRY");
            System.exit(2);
        }
        CompletableFuture<String> end = new CompletableFuture<>();
        try (ZipFile zip = new ZipFile(args[0]); MediaPlayer player = new OrvMediaPlayer()) {
            if (zip.getEntry(args[1]) == null) {
                throw new IOException("there is no entry " + args[1]);
            }
            player.addListener(new PlayerListener() {
                @Override public void onCompletion(MediaPlayer of) { end.complete("the end"); }
                @Override public void onError(MediaPlayer of, MediaException e) {
                    end.completeExceptionally(e);
                }
            });
            player.setDataSource(new PlayFromZip(zip, zip.getEntry(args[1])));
            player.prepareAndWait();
            player.start();
            System.out.println(end.get());
        } catch (IOException | ExecutionException e) {
            Throwable why = e instanceof ExecutionException ? e.getCause() : e;
            String advice = why instanceof MediaException m ? "; " + m.error().advice() : "";
            System.err.println(args[0] + ": " + why.getMessage() + advice);
            System.exit(1);
        }
    }
}
