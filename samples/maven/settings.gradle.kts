// SPDX-License-Identifier: Apache-2.0
rootProject.name = "play"
