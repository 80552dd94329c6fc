#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""The doctor's look at a platform tree: one is laid out from the desktop's
headers, whole and with a fault."""

import pathlib
import re
import shutil
import subprocess
import tempfile
import unittest

import environment
import blueprint
import tree_slots

PACKAGED = pathlib.Path("/usr/include/android")
PLATFORM = environment.SOURCE / "platform/include"
INTERFACE = "frameworks/av/include/media/MediaPlayerInterface.h"
TRACK = "frameworks/av/include/media/MediaTrack.h"
METADATA = "frameworks/av/media/libmedia/include/media/Metadata.h"
SURFACE = "frameworks/native/libs/gui/include/gui/Surface.h"
PARCEL = "frameworks/native/libs/binder/include/binder/Parcel.h"
RUNTIME = "frameworks/base/core/jni/include/android_runtime"
STRING = "system/core/libutils/include/utils/String8.h"
HELP = "libnativehelper/include/nativehelper/JNIHelp.h"
PLATFORM_HELP = "libnativehelper/include_platform_header_only/nativehelper/JNIPlatformHelp.h"
ENGINE = "vendor/television/include/orvtarn"
LAYOUT = {
    INTERFACE: PLATFORM / "media/MediaPlayerInterface.h",
    TRACK: PLATFORM / "media/MediaTrack.h",
    METADATA: PLATFORM / "media/Metadata.h",
    PARCEL: PLATFORM / "binder/Parcel.h",
    RUNTIME: PLATFORM / "android_runtime",
    "frameworks/native/libs/gui/include/gui": PLATFORM / "gui",
    "libnativehelper/include_jni/jni.h": next(
        path for path in (PACKAGED / "nativehelper/jni.h", PACKAGED / "jni.h") if path.exists()),
    ENGINE: environment.SOURCE / "engine/include/orvtarn",
}
# What Debian packages of the rest differs between its releases.
MODULES = {"android": "system/core/liblog", "android-base": "system/libbase",
           "cutils": "system/core/libcutils", "log": "system/core/liblog",
           "utils": "system/core/libutils"}
LAYOUT.update((f"{MODULES.get(folder.name, 'system/core')}/include/{folder.name}", folder)
              for folder in PACKAGED.iterdir()
              if folder.is_dir() and folder.name not in ("binder", "gui", "media", "nativehelper"))
# Debian 13 has it beside the folders, as <android/log.h> of /usr/include.
if (PACKAGED / "log.h").exists():
    LAYOUT["system/core/liblog/include/android/log.h"] = PACKAGED / "log.h"
THROWS = "int jniThrowException(JNIEnv* env, const char* className, const char* message);\n"
DESCRIPTOR = "int jniGetFDFromFileDescriptor(JNIEnv* env, jobject fileDescriptor);\n"
# Fewer sources than all where the fault is in one header.
SERVICE = "jni/media-service/ServicePlayback.cpp"
PLAYER = "jni/PlayerContext.cpp"


class DoctorTreeTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.tree = self.folder / "tree"
        for path, origin in LAYOUT.items():
            (self.tree / path).parent.mkdir(parents=True, exist_ok=True)
            (shutil.copytree if origin.is_dir() else shutil.copyfile)(origin, self.tree / path)
        self.write(HELP, THROWS + DESCRIPTOR)

    def write(self, path, text):
        file = self.tree / path
        file.parent.mkdir(parents=True, exist_ok=True)
        file.write_text("#pragma once\n#include <jni.h>\n" + text)

    def change(self, path, pattern, by, count=0):
        text = (self.tree / path).read_text()
        changed, times = re.subn(pattern, by, text, count=count)
        self.assertGreater(times, 0, pattern)
        (self.tree / path).write_text(changed)

    def checkout(self, sources):
        """This project with fewer sources in its build file."""
        checkout = pathlib.Path(tempfile.mkdtemp(dir=self.folder))
        product = checkout / environment.PRODUCT_SOURCE.relative_to(environment.SOURCE)
        product.mkdir(parents=True)
        for name in ("docs", "engine", "platform"):
            (checkout / name).symlink_to(environment.SOURCE / name)
        for path in environment.PRODUCT_SOURCE.iterdir():
            (product / path.name).symlink_to(path)
        text = (product / "Android.bp").read_text()
        for source in set(blueprint.strings_of(text, "srcs")) - set(sources):
            text = text.replace(f'        "{source}",\n', "")
        (product / "Android.bp").unlink()
        (product / "Android.bp").write_text(text)
        return checkout

    def check(self, *sources):
        """(status, sentences): without the numbers of lines, which change."""
        checkout = self.checkout(sources) if sources else environment.SOURCE
        status, lines, errors = environment.run("tree.py", self.tree, checkout)
        self.assertEqual(errors, [])
        return status, [re.sub(r"(\.(?:h|cpp)):\d+", r"\1", line) for line in lines]

    def assert_findings(self, sources, *sentences):
        status, lines = self.check(*sources)
        self.assertEqual((status, lines[:-1]), (1, list(sentences)))
        self.assertRegex(lines[-1], rf"^{self.tree}: findings: {len(sentences)}; \d+ of "
                         rf"{len(sources)} sources compile$")

    def assert_sound(self, *sources):
        count = len(sources or environment.cmake_sources())
        self.assertEqual(self.check(*sources), (0, [
            f"{self.tree}: all {count} sources compile for 32-bit ARM, the base class has its "
            "19 operations in their slots"]))

    maxDiff = None

    # --- what is sound

    def test_a_whole_tree_is_sound(self):
        self.change(INTERFACE, "class Parcel;", "class Parcel;\nstruct IStreamSource;")
        self.change(PARCEL, "#pragma once", "#pragma once\n#include <cutils/list.h>")
        # Other copies in the tree do not count.
        for header in ("utils/RefBase.h", "cutils/list.h"):
            self.write(f"frameworks/native/host/include/{header}", "#error host")
        self.assert_sound()

    def test_a_flat_folder_of_headers_is_sound(self):
        flat = self.folder / "flat"
        for path in LAYOUT:
            origin = self.tree / path
            below = flat / re.split(r"/(?:include\w*)/", path)[-1]
            below.parent.mkdir(parents=True, exist_ok=True)
            (shutil.copytree if origin.is_dir() else shutil.copyfile)(origin, below)
        (flat / "nativehelper").mkdir()
        (self.tree / HELP).rename(flat / "nativehelper/JNIHelp.h")
        (flat / "jni.h").rename(flat / "nativehelper/jni.h")
        self.tree = flat
        self.assert_sound(SERVICE, PLAYER, "jni/PlaybackCommands.cpp", "jni/VideoSurface.cpp")

    def test_the_trees_own_c_and_cpp_libraries_are_taken(self):
        cross = pathlib.Path("/usr/arm-linux-gnueabihf/include")
        newest = max(cross.glob("c++/[0-9]*"), key=lambda path: int(path.name))
        for path in ("bionic/libc", "external/libcxx", "external/libcxxabi"):
            (self.tree / path).mkdir(parents=True)
        (self.tree / "external/libcxx/include").symlink_to(newest)
        (self.tree / "external/libcxxabi/include").symlink_to(newest / "arm-linux-gnueabihf")
        own = self.tree / "bionic/libc/include"
        own.mkdir()
        for path in cross.iterdir():
            if path.name != "pthread.h":
                (own / path.name).symlink_to(path)
        _, lines = self.check("os/Thread.cpp")
        self.assertTrue(any(line.startswith("header pthread.h is missing, which ")
                            for line in lines), lines)

    # --- headers

    def test_a_missing_header_is_named_with_its_module_and_folder(self):
        for module, path in {
                "libandroid_runtime": f"{RUNTIME}/AndroidRuntime.h", "libbinder": PARCEL,
                "libgui": SURFACE, "liblog": "system/core/liblog/include/log/log.h",
                "libmedia": METADATA, "libnativehelper": HELP, "libutils": STRING}.items():
            with self.subTest(module):
                hidden = self.folder / "hidden.h"
                (self.tree / path).rename(hidden)
                status, lines = self.check("os/MemoryPool.cpp")
                hidden.rename(self.tree / path)
                root, header = re.fullmatch(r"(.*/include)/(.*)", path).groups()
                self.assertEqual(status, 1)
                self.assertRegex(lines[0], rf"^header {header} is missing \(module {module}\): "
                                 rf"platform trees keep it in (.* or )?{root}( or .*)?$")

    def test_a_header_of_a_header_is_named_with_the_one_that_includes_it(self):
        self.change(PARCEL, "#pragma once", "#pragma once\n#include <android/os/Mode.h>")
        sentence = ("header android/os/Mode.h is missing, which "
                    "frameworks/native/libs/binder/include/binder/Parcel.h includes")
        sources = ["dispatch/MsgDispatcher.cpp", "os/MemoryPool.cpp"]
        self.assert_findings(sources, sentence)
        aidl = self.tree / "frameworks/native/libs/binder/aidl/android/os/Mode.aidl"
        aidl.parent.mkdir(parents=True)
        aidl.write_text("")
        self.assert_findings(sources,
                             sentence + "; the tree's build makes it from android/os/Mode.aidl")
        # A source's own header is not what the build gives to others.
        self.write("frameworks/native/libs/android/os/Mode.h", "#error not given to others")
        self.write("out/soong/.intermediates/frameworks/native/libs/binder/gen/include/"
                   "android/os/Mode.h", "")
        self.assert_sound(*sources)

    def test_before_android_9_there_is_no_media_track(self):
        (self.tree / TRACK).unlink()
        self.assert_findings(
            [SERVICE], "header media/MediaTrack.h is missing (module libmedia): platform trees "
            "keep it in frameworks/av/include or frameworks/av/media/libmedia/include; "
            "begins with Android 9")

    def test_without_the_vendors_headers_the_rest_is_checked(self):
        shutil.rmtree(self.tree / ENGINE)
        self.change(METADATA, r"\bkAny\b", "kNone")
        self.assert_findings(
            ["jni/media-service/ServiceMetadata.cpp", PLAYER],
            "header orvtarn/TarnPlayer.h is missing (module liborvtarn_headers): it comes with "
            "the engine's vendor; the rest was checked with engine/include of this project",
            "class Metadata (media/Metadata.h, module libmedia) has no kAny, which "
            "jni/media-service/ServiceMetadata.cpp uses")

    def test_a_record_that_the_vendors_headers_lack_is_named(self):
        (self.tree / ENGINE / "DivxRecords.h").unlink()
        self.assert_findings(
            [SERVICE], "header orvtarn/DivxRecords.h is missing (module liborvtarn_headers): it "
            "comes with the engine's vendor")

    # --- classes and functions

    def test_a_descriptors_number_is_in_one_of_two_headers(self):
        sources = ["jni/PlaybackCommands.cpp"]
        self.write(HELP, THROWS)
        self.write(PLATFORM_HELP, DESCRIPTOR)
        self.assert_sound(*sources)
        (self.tree / PLATFORM_HELP).unlink()
        self.assert_findings(
            sources, "function jniGetFDFromFileDescriptor is missing (nativehelper/JNIHelp.h, "
            "module libnativehelper), which jni/PlaybackCommands.cpp uses; declared by "
            "nativehelper/JNIHelp.h up to Android 11; from 12 on inline in "
            "nativehelper/JNIPlatformHelp.h, over android/file_descriptor_jni.h; the sources "
            "take either")

    def test_what_a_class_lacks_or_hides_is_named(self):
        sources = ["jni/PlaybackCommands.cpp", "jni/KeyValueArrays.cpp"]
        class_ = "class String8 (utils/String8.h, module libutils)"
        since = ("there from Android 8.1 on; string(), which it replaces, is private in "
                 "Android 14")
        whole = (self.tree / STRING).read_text()
        self.change(STRING, r"(.*\bc_str\(\) const.*)", r"private:\n\1\npublic:", count=1)
        # Releases of the header use it themselves, too.
        status, lines = self.check(*sources)
        self.assertEqual((status, len(lines)), (1, 2), lines)
        self.assertRegex(lines[0], re.escape(f"{class_} keeps c_str to itself, which ")
                         + r"\S+" + re.escape(f" uses; {since}") + "$")
        (self.tree / STRING).write_text(whole)
        self.change(STRING, r"\bc_str\b", "c_text")
        self.assert_findings(sources, f"{class_} has no c_str, which jni/PlaybackCommands.cpp "
                             f"uses; {since}")

    def test_a_surface_without_its_producer_is_named(self):
        self.change(SURFACE, "getIGraphicBufferProducer", "getProducer")
        self.assert_findings(
            ["jni/VideoSurface.cpp"], "class Surface (gui/Surface.h, module libgui) has no "
            "getIGraphicBufferProducer, which jni/VideoSurface.cpp uses")

    def test_a_missing_function_class_or_constant_is_named(self):
        self.change(f"{RUNTIME}/android_view_Surface.h", "_getSurface", "_surface")
        self.change(METADATA, r"\bMetadata\b", "Records")
        self.change(INTERFACE, "MEDIA_TIMED_TEXT", "MEDIA_TEXT")
        self.assert_findings(
            ["jni/VideoSurface.cpp", "jni/media-service/ServiceMetadata.cpp",
             "jni/media-service/OrvMediaService.cpp"],
            "function android_view_Surface_getSurface is missing "
            "(android_runtime/android_view_Surface.h, module libandroid_runtime), which "
            "jni/VideoSurface.cpp uses",
            "constant MEDIA_TIMED_TEXT is missing (media/MediaPlayerInterface.h, module "
            "libmedia), which jni/media-service/OrvMediaService.cpp uses",
            "class Metadata is missing (media/Metadata.h, module libmedia), which "
            "jni/media-service/ServiceMetadata.cpp uses")

    def test_other_parameters_are_named(self):
        self.change(f"{RUNTIME}/AndroidRuntime.h", ", int count", "")
        self.assert_findings(
            ["jni/NativeMethodTable.cpp"], "registerNativeMethods takes other arguments in "
            f"{RUNTIME}/AndroidRuntime.h than jni/NativeMethodTable.cpp gives it")

    def test_a_class_for_a_struct_is_named_once(self):
        other = "class IStreamSource;\n"
        sentence = ("IStreamSource is a class in the tree and a struct in the sources; "
                    "a struct in all releases, as in the sources")
        # The sources' own declaration comes first, then the tree's.
        self.write(HELP, THROWS + DESCRIPTOR + f"namespace android {{ {other} }}\n")
        self.assert_findings([PLAYER], sentence)
        self.change(INTERFACE, "class Parcel;\n", rf"\g<0>{other}")
        self.assert_findings([SERVICE, PLAYER], sentence)

    def test_what_has_no_words_is_shown_in_one_line(self):
        self.change(PARCEL, "class Parcel {", "class Parcel { int broken = ;")
        self.assert_findings(["dispatch/MsgDispatcher.cpp"], "frameworks/native/libs/binder/"
                             "include/binder/Parcel.h: expected expression")

    def test_warnings_inside_the_tree_are_its_own(self):
        self.change(INTERFACE, "class Parcel;", "class Parcel;\nstruct Odd;\nclass Odd;")
        self.assert_sound(SERVICE)

    # --- the base class

    def test_operations_that_the_base_class_lacks_are_named(self):
        volume = ("class MediaPlayerBase has no operation setVolume; expected in virtual slot 23: "
                  "virtual status_t setVolume(float left, float right) = 0")
        self.change(INTERFACE, r"    virtual status_t setVolume\(.*\n", "")
        self.assert_findings([SERVICE], volume)
        self.change(INTERFACE, r"    virtual status_t release\(.*\n", "")
        self.assert_findings(
            [SERVICE, PLAYER], volume,
            "class MediaPlayerBase has no operation release; expected in virtual slot 24: "
            "virtual status_t release() = 0")

    def test_another_type_of_an_operation_is_named(self):
        expected = "expected in virtual slot 14: virtual status_t seekTo(int msec, int mode) = 0"
        self.change(INTERFACE, "int msec, int mode", "int msec, SeekMode mode")
        self.change(INTERFACE, "class Parcel;", "class Parcel;\nenum class SeekMode : int {};")
        self.assert_findings([SERVICE], "operation seekTo of class MediaPlayerBase is "
                             f"seekTo(int, SeekMode); {expected}")
        self.change(INTERFACE, "status_t seekTo.*;", "bool seekTo(int msec, int mode) = 0;")
        self.assert_findings([SERVICE], "operation seekTo of class MediaPlayerBase returns bool; "
                             f"{expected}")

    def test_another_order_of_slots_is_named(self):
        self.change(INTERFACE, r"(.* start\(\) = 0;\n)(.* stop\(\) = 0;\n)", r"\2\1")
        swapped = ["virtual slot 10 of class MediaPlayerBase is stop, not start",
                   "virtual slot 11 of class MediaPlayerBase is start, not stop"]
        self.assert_findings([SERVICE], *swapped)
        # One more before them moves them both.
        self.change(INTERFACE, "    virtual status_t prepare\\(", r"    virtual int more();\n\g<0>")
        self.assert_findings(
            [SERVICE], "class MediaPlayerBase has an operation more, more(), in virtual slot 8: "
            "those behind it are a slot too far back",
            *[text.replace("11", "12").replace("10", "11") for text in swapped])

    def test_one_more_pure_operation_is_named(self):
        behind = r"(    virtual status_t release\(\) = 0;\n)"
        more = "    virtual bool suspend() = 0;\n"
        self.change(INTERFACE, behind, rf"\1{more}")
        self.assert_findings(
            [SERVICE, PLAYER], "class TarnPlayer does not have the operation suspend, which is "
            "pure in class MediaPlayerBase (media/MediaPlayerInterface.h, module libmedia)")
        self.change(INTERFACE, more.replace("(", r"\(").replace(")", r"\)"), "")
        self.change(INTERFACE, behind, rf"{more}\1")
        self.assert_findings(
            [SERVICE, PLAYER], "class MediaPlayerBase has an operation more, suspend(), in virtual "
            "slot 24: those behind it are a slot too far back")

    def test_a_missing_base_class_is_named(self):
        self.change(INTERFACE, "class MediaPlayerBase ", "class Playback ")
        status, lines = self.check(SERVICE)
        self.assertEqual((status, lines[0]), (
            1, "class MediaPlayerBase is missing (media/MediaPlayerInterface.h, module libmedia), "
            f"which {ENGINE}/TarnPlayer.h uses"))

    def test_slots_that_cannot_be_seen_are_not_taken_for_right(self):
        self.change(INTERFACE, "public:\n    // Receives",
                    "protected:\n    explicit MediaPlayerBase(int);\n\\g<0>")
        status, lines = self.check(SERVICE)
        self.assertEqual((status, len(lines)), (1, 2), lines)
        self.assertRegex(lines[0], "^the slots of class MediaPlayerBase could not be seen: "
                         "constructor for .* must explicitly initialize the base class")

    def test_the_page_lists_the_operations_by_slot(self):
        page = (environment.SOURCE / "docs/platform-tree.md").read_text()
        listed = re.findall(r"^\| (\d+) \| `(.*)` \|$", page, re.MULTILINE)
        operations = tree_slots.read_operations(PLATFORM / "media/MediaPlayerInterface.h")
        self.assertEqual(len(operations), 19)
        self.assertEqual(listed, [(str(operation.slot), operation.declaration[len("virtual "):])
                                  for operation in operations])

    # --- unfit input

    def refused(self, tree, why):
        self.assertEqual(environment.run("tree.py", tree, environment.SOURCE),
                         (2, [], [f"orv: {tree}: {why}"]))

    def test_what_is_no_tree_is_refused(self):
        self.refused(self.folder / "none", "there is no such folder")
        self.refused(self.tree / PARCEL, "not a folder")
        empty = self.folder / "empty"
        empty.mkdir()
        self.refused(empty, "holds no header that the sources include")

    def test_without_a_compiler_that_works_nothing_is_sound(self):
        tool = environment.SOURCE / "tools/inspect/tree.py"

        def run():
            return subprocess.run(["/usr/bin/python3", "-B", tool, self.tree, environment.SOURCE],
                                  env={"PATH": str(self.folder)}, capture_output=True, text=True)
        done = run()
        self.assertEqual((done.returncode, done.stdout, done.stderr), (
            2, "", "orv: clang++ is not installed; it comes with the package clang\n"))
        broken = self.folder / "clang++"
        broken.write_text("#!/bin/sh\necho clang++: error: no such target >&2\nexit 1\n")
        broken.chmod(0o755)
        done = run()
        source = environment.cmake_sources()[0]
        self.assertEqual((done.returncode, done.stdout.splitlines()[0]),
                         (1, f"{source}: clang++: error: no such target"))


if __name__ == "__main__":
    unittest.main()
