// SPDX-License-Identifier: Apache-2.0
// The same for Gradle: gradle -Porv.repository=/path/to/build/maven run --args=film.mkv
plugins {
    application
}

val orvVersion = "1.0.0"

repositories {
    maven { url = uri(providers.gradleProperty("orv.repository").get()) }
}

dependencies {
    implementation("com.quintora.mmp:mediaplayer-orv:$orvVersion")
    runtimeOnly("com.quintora.mmp:mediaplayer-orv:$orvVersion:linux-x86_64")
}

java {
    sourceCompatibility = JavaVersion.VERSION_17
}

application {
    mainClass.set("sample.Play")
    // Without it Java warns from version 24 on.
    applicationDefaultJvmArgs = listOf("--enable-native-access=ALL-UNNAMED")
}
