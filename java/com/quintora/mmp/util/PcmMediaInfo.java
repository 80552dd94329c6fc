// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.util;

import java.util.Set;

/**
 * The description of a raw PCM stream, which does not describe itself. The fields are read by the
 * native half; {@link #of} and the {@code with} methods make complete descriptions.
 */
public class PcmMediaInfo {
    /** {@link #mediaType}: an elementary audio stream. */
    public static final int MEDIA_TYPE_AUDIO = 1;

    /** {@link #audioCodec}: PCM. */
    public static final int AUDIO_CODEC_PCM = 1;

    /** {@link #MEDIA_TYPE_AUDIO}. */
    public int mediaType = MEDIA_TYPE_AUDIO;

    /** Milliseconds, 0 when unknown. */
    public int totalDuration;

    /** Bytes, 0 when unknown. The native half carries sizes below 2 GiB alone. */
    public long size;

    /** Whether audio and video are kept in step: 0 or 1. */
    public int fgSynchronized;

    /** {@link #AUDIO_CODEC_PCM}. */
    public int audioCodec = AUDIO_CODEC_PCM;

    /** The samples; never null in a description that is given to a player. */
    public AudioPcmInfo audioPcmInfo = new AudioPcmInfo();

    /** A description of samples that are not described yet. */
    public PcmMediaInfo() {}

    /**
     * Signed whole-number samples, or unsigned ones when they have 8 bits.
     *
     * @param sampleRate samples per second, 1000 to 384000
     * @param channels 1 to 8
     * @param bitsPerSample 8, 16, 24 or 32
     * @return the description, little endian
     */
    public static PcmMediaInfo of(int sampleRate, int channels, int bitsPerSample) {
        PcmMediaInfo info = new PcmMediaInfo();
        AudioPcmInfo pcm = info.audioPcmInfo;
        pcm.pcm_type = bitsPerSample == 8 ? AudioPcmInfo.UNSIGNED : AudioPcmInfo.SIGNED;
        pcm.sampleRate = sampleRate;
        pcm.channelNumber = channels;
        pcm.bitsPerSample = bitsPerSample;
        pcm.blockAlign = (short) (channels * bitsPerSample / 8);
        return info;
    }

    /**
     * Changes the kind of samples.
     *
     * @param pcmType one of the constants of {@link AudioPcmInfo}
     * @return this
     */
    public PcmMediaInfo withType(int pcmType) {
        audioPcmInfo.pcm_type = pcmType;
        return this;
    }

    /**
     * Makes the samples big endian.
     *
     * @return this
     */
    public PcmMediaInfo withBigEndian() {
        audioPcmInfo.bigEndian = 1;
        return this;
    }

    /**
     * Says how long the stream is.
     *
     * @param millis milliseconds, 0 when unknown
     * @param bytes bytes below 2 GiB, 0 when unknown
     * @return this
     */
    public PcmMediaInfo withLength(int millis, long bytes) {
        totalDuration = millis;
        size = bytes;
        return this;
    }

    /**
     * Checks the description as a player will.
     *
     * @throws IllegalArgumentException naming the value that is out of range and its range
     */
    public void check() {
        require(audioPcmInfo != null, "audioPcmInfo is null");
        require(mediaType == MEDIA_TYPE_AUDIO,
                "the media type " + mediaType + "; only 1, audio, is possible");
        require(audioCodec == AUDIO_CODEC_PCM,
                "the codec " + audioCodec + "; only 1, PCM, is possible");
        require(totalDuration >= 0,
                "a duration of " + totalDuration + " ms; 0, for unknown, or more is possible");
        require(size >= 0 && size <= Integer.MAX_VALUE,
                "a size of " + size + " bytes; 0, for unknown, to 2147483647 are possible");
        audioPcmInfo.check();
    }

    private static void require(boolean holds, String otherwise) {
        if (!holds) {
            throw new IllegalArgumentException("PCM description: " + otherwise);
        }
    }

    /** How the samples are laid out. */
    public static class AudioPcmInfo {
        /** {@link #pcm_type}: signed whole numbers. */
        public static final int SIGNED = 0;

        /** {@link #pcm_type}: unsigned whole numbers of 8 bits. */
        public static final int UNSIGNED = 1;

        /** {@link #pcm_type}: floating point of 32 bits. */
        public static final int FLOAT = 2;

        /** {@link #pcm_type}: A-law, 8 bits. */
        public static final int A_LAW = 3;

        /** {@link #pcm_type}: mu-law, 8 bits. */
        public static final int MU_LAW = 4;

        /** The kind of samples, one of the constants. */
        public int pcm_type;

        /** Channels, 1 to 8. */
        public int channelNumber;

        /** Samples per second and channel, 1000 to 384000. */
        public int sampleRate;

        /** Bytes of one sample of all channels. */
        public short blockAlign;

        /** 8, 16, 24 or 32. */
        public int bitsPerSample;

        /** 1 for big endian, 0 for little endian. */
        public int bigEndian;

        /** A description with all values 0. */
        public AudioPcmInfo() {}

        void check() {
            require(pcm_type >= SIGNED && pcm_type <= MU_LAW,
                    "samples of type " + pcm_type + "; 0 to 4 are possible");
            require(channelNumber >= 1 && channelNumber <= 8,
                    channelNumber + " channels; 1 to 8 are possible");
            require(sampleRate >= 1000 && sampleRate <= 384_000,
                    sampleRate + " samples per second; 1000 to 384000 are possible");
            checkBits();
            int frame = channelNumber * bitsPerSample / 8;
            require(blockAlign == frame,
                    "a block of " + blockAlign + " bytes; one sample of all channels has " + frame);
        }

        private void checkBits() {
            switch (pcm_type) {
                case SIGNED -> require(Set.of(8, 16, 24, 32).contains(bitsPerSample),
                        bitsPerSample + " bits; signed samples have 8, 16, 24 or 32");
                case UNSIGNED -> require(bitsPerSample == 8,
                        bitsPerSample + " bits; unsigned samples have 8");
                case FLOAT -> require(bitsPerSample == 32,
                        bitsPerSample + " bits; floating-point samples have 32");
                default -> require(bitsPerSample == 8,
                        bitsPerSample + " bits; A-law and mu-law samples have 8");
            }
        }
    }
}
