// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.io.InputStream;
import java.lang.module.FindException;
import java.lang.module.ModuleFinder;
import java.lang.module.ModuleReader;
import java.lang.module.ModuleReference;
import java.net.URL;
import java.net.URLConnection;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.Collections;
import java.util.List;

/** Looks for the native JARs on the class path and on the module path. */
final class BundleFinder {
    private final ClassLoader loader;
    private final Path[] modulePath;

    /** Of that class loader, and of a module path as Java's option is written; it may be null. */
    BundleFinder(ClassLoader loader, String modulePath) {
        this.loader = loader;
        this.modulePath =
                LibraryPath.folders(modulePath).stream().map(Path::of).toArray(Path[]::new);
    }

    static BundleFinder ofThisVm() {
        return new BundleFinder(
                BundleFinder.class.getClassLoader(), System.getProperty("jdk.module.path"));
    }

    /** Those for that machine, of any version. */
    List<NativeBundle> find(Machine machine) throws IOException {
        String folder = NativeBundle.folder(machine);
        List<NativeBundle> found = new ArrayList<>();
        for (URL list : Collections.list(loader.getResources(folder + NativeBundle.LIST))) {
            found.add(new NativeBundle(list.toString(), name -> read(new URL(list, name))));
        }
        // Nothing requires the native JAR as a module, so it is in no loader.
        return found.isEmpty() ? findInModules(folder) : found;
    }

    /** The names of the machines that there are native JARs for, of those that are known. */
    List<String> machines() throws IOException {
        List<String> found = new ArrayList<>();
        for (String name : Machine.KNOWN) {
            String[] words = name.split("-");
            if (!find(new Machine(words[0], words[1])).isEmpty()) {
                found.add(name);
            }
        }
        return found;
    }

    private List<NativeBundle> findInModules(String folder) throws IOException {
        List<NativeBundle> found = new ArrayList<>();
        for (ModuleReference module : modules()) {
            String list = folder + NativeBundle.LIST;
            try (ModuleReader reader = module.open()) {
                if (reader.find(list).isPresent()) {
                    String place = module.location().map(Object::toString).orElse("") + "!/" + list;
                    found.add(new NativeBundle(place, name -> read(module, folder + name)));
                }
            }
        }
        return found;
    }

    private Iterable<ModuleReference> modules() throws IOException {
        try {
            return ModuleFinder.of(modulePath).findAll();
        } catch (FindException e) {
            throw new IOException(
                    "the module path " + List.of(modulePath) + " cannot be read: " + e.getMessage(),
                    e);
        }
    }

    private static byte[] read(ModuleReference module, String name) throws IOException {
        try (ModuleReader reader = module.open();
                InputStream in =
                        reader.open(name).orElseThrow(() -> new NoSuchFileException(name))) {
            return in.readAllBytes();
        }
    }

    /** Without the cache of opened JARs, in which it would stay open. */
    private static byte[] read(URL file) throws IOException {
        URLConnection connection = file.openConnection();
        connection.setUseCaches(false);
        try (InputStream in = connection.getInputStream()) {
            return in.readAllBytes();
        }
    }
}
