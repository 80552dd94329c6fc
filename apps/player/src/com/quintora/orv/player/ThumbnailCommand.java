// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.ColorMode;
import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaStream;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PictureDetails;
import com.quintora.mmp.Pictures;
import com.quintora.mmp.Thumbnail;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.io.ByteArrayOutputStream;
import java.io.IOException;
import java.io.UncheckedIOException;
import java.nio.ByteOrder;
import java.nio.file.Path;
import java.util.List;
import java.util.Optional;
import java.util.concurrent.Callable;
import javax.imageio.ImageIO;
import picocli.CommandLine.Model.CommandSpec;
import picocli.CommandLine.ParameterException;

/** Writes one picture of a video. */
final class ThumbnailCommand implements Callable<Integer> {
    private static final int USUAL_HEIGHT = 180;

    private final CommandSpec command;
    private String source;
    private Path out;
    private int at;
    private Size size;

    ThumbnailCommand() {
        var arguments =
                Arguments.ofCommand(
                        this, "thumbnail", "Writes one picture of a video as a PNG file.");
        arguments.addSource("FILE", value -> source = value);
        arguments.addPicture("OUT.png", value -> out = value);
        arguments.add(
                Arguments.option("--at", int.class, value -> at = value)
                        .paramLabel("TIME")
                        .defaultValue("0")
                        .converters(Times::parseMillis)
                        .description("Of which moment: seconds, or h:mm:ss.")
                        .build());
        arguments.add(
                Arguments.option("--size", Size.class, value -> size = value)
                        .paramLabel("WxH")
                        .converters(Size::parse)
                        .description(
                                "How large, at most 8192x255; without it, 180 rows in the video's"
                                        + " shape.")
                        .build());
        command = arguments.command();
    }

    CommandSpec command() {
        return command;
    }

    @Override
    public Integer call() throws Failure {
        check();
        try (OrvMediaPlayer player = Media.open(source)) {
            seek(player);
            OutputFile.write(out, png(draw(player)));
        }
        return 0;
    }

    private void check() {
        if (!OutputFile.isStandardOutput(out) && !out.toString().toLowerCase().endsWith(".png")) {
            throw new ParameterException(
                    command.commandLine(),
                    "a thumbnail is a PNG file; '" + out + "' is not named so");
        }
        if (size != null && size.height() > Pictures.MAX_THUMBNAIL_HEIGHT) {
            throw new ParameterException(
                    command.commandLine(),
                    "a thumbnail has at most "
                            + Pictures.MAX_THUMBNAIL_HEIGHT
                            + " rows, not "
                            + size.height());
        }
        if (size != null && size.width() > Pictures.MAX_THUMBNAIL_WIDTH) {
            throw new ParameterException(
                    command.commandLine(),
                    "a thumbnail has at most "
                            + Pictures.MAX_THUMBNAIL_WIDTH
                            + " columns, not "
                            + size.width());
        }
    }

    private void seek(OrvMediaPlayer player) throws Failure {
        if (player.getVideoWidth() == 0) {
            throw new Failure("there is no video in '" + source + "'");
        }
        int duration = player.getDuration();
        if (duration > 0 && at > duration) {
            throw Failure.endsBefore(source, duration, "that moment");
        }
        Approach.of(player).to(at);
    }

    private Thumbnail draw(OrvMediaPlayer player) throws Failure {
        Size wanted = size != null ? size : shapeOf(player);
        return player.pictures()
                .thumbnailAndWait(wanted.width(), wanted.height(), ColorMode.XRGB8888)
                .orElseThrow(() -> new Failure("no picture could be made of '" + source + "'"));
    }

    /** As displayed: turned, and with the pixels made square. */
    private static Size shapeOf(OrvMediaPlayer player) {
        double ratio = (double) player.getVideoWidth() / player.getVideoHeight();
        PictureDetails picture = shownPicture(player).orElse(null);
        if (picture != null && picture.displayHeight() > 0) {
            ratio = (double) picture.displayWidth() / picture.displayHeight();
        }
        int width = (int) Math.round(USUAL_HEIGHT * ratio);
        return new Size(
                Math.max(1, Math.min(Pictures.MAX_THUMBNAIL_WIDTH, width)), USUAL_HEIGHT);
    }

    private static Optional<PictureDetails> shownPicture(OrvMediaPlayer player) {
        var shown = player.tracks().video().stream().filter(track -> track.flags().isSelected());
        List<MediaStream> streams =
                player.tracks().description().map(MediaDescription::streams).orElse(List.of());
        return shown.findFirst()
                .flatMap(track -> new Streams(streams).of(MediaStream.Kind.VIDEO, track.index()))
                .flatMap(MediaStream::picture);
    }

    private static byte[] png(Thumbnail picture) {
        BufferedImage image =
                new BufferedImage(picture.width(), picture.height(), BufferedImage.TYPE_INT_RGB);
        int[] pixels = ((DataBufferInt) image.getRaster().getDataBuffer()).getData();
        picture.pixels()
                .order(ByteOrder.LITTLE_ENDIAN)
                .asIntBuffer()
                .get(pixels);
        // Not by way of a temporary file.
        ImageIO.setUseCache(false);
        var bytes = new ByteArrayOutputStream();
        try {
            ImageIO.write(image, "png", bytes);
        } catch (IOException e) {
            throw new UncheckedIOException(e);
        }
        return bytes.toByteArray();
    }
}
