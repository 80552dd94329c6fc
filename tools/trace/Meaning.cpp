// SPDX-License-Identifier: Apache-2.0
#include "Meaning.h"

namespace orvtrace {

namespace {

constexpr std::string_view kBridgeTag = "OrvMediaClient-JNI";
constexpr std::string_view kServiceTag = "OrvMediaService";
constexpr std::string_view kDispatcherTag = "ORV::SyncToAsync";
constexpr std::string_view kOtherTags[] = {"TarnPlayer", "Customer_media_Utils"};

bool contains(std::string_view text, std::string_view part) {
    return text.find(part) != std::string_view::npos;
}

bool startsWith(std::string_view text, std::string_view start) {
    return text.substr(0, start.size()) == start;
}

bool endsWith(std::string_view text, std::string_view end) {
    return text.size() >= end.size() && text.substr(text.size() - end.size()) == end;
}

// "name", "name:", "name():" and "name(type, type):", of which name is left.
bool takeName(std::string_view text, std::string_view& name) {
    if (!text.empty() && text.back() == ':') text.remove_suffix(1);
    if (!text.empty() && text.back() == ')') text = text.substr(0, text.find('('));
    name = text;
    return !text.empty() && text.find_first_of(" ()=,") == std::string_view::npos;
}

struct Ending {
    std::string_view text;
    Meaning::Kind kind;
};

constexpr Ending kEndings[] = {
    {" Enter", Meaning::Kind::kEnter},
    {" Leave", Meaning::Kind::kLeave},
    {" return NULL, leave", Meaning::Kind::kLeave},
    {" leave", Meaning::Kind::kLeave},
    {" occur", Meaning::Kind::kOccur},
    {"end", Meaning::Kind::kLeave},  // "OrvMediaClient_setTS()end"
};

void readSteps(std::string_view text, Meaning& meaning) {
    if (startsWith(text, "JNI_OnLoad():")) {
        meaning.kind = Meaning::Kind::kLoad;
        return;
    }
    // A list of no tracks is left so.
    if (endsWith(text, " count = 0, no need to fetch subtitle info")) {
        meaning.kind = Meaning::Kind::kLeave;
        meaning.name = text.substr(0, text.find('('));
        return;
    }
    for (const Ending& ending : kEndings) {
        if (!endsWith(text, ending.text)) continue;
        const std::string_view head = text.substr(0, text.size() - ending.text.size());
        if (ending.text == "end" && !endsWith(head, "()")) return;
        if (takeName(head, meaning.name)) meaning.kind = ending.kind;
        return;
    }
}

uint64_t readAddress(std::string_view text) {
    const std::string_view key = "this=";
    size_t at = text.find(key);
    if (at == std::string_view::npos) return 0;
    at += key.size();
    if (text.substr(at, 2) == "0x") at += 2;
    uint64_t address = 0;
    for (; at < text.size(); ++at) {
        const char c = text[at];
        if (c >= '0' && c <= '9') {
            address = address * 16 + (c - '0');
        } else if (c >= 'a' && c <= 'f') {
            address = address * 16 + (c - 'a' + 10);
        } else {
            break;
        }
    }
    return address;
}

void readServiceLine(std::string_view text, Meaning& meaning) {
    while (!text.empty() && text.front() == ' ') text.remove_prefix(1);
    if (startsWith(text, "OrvMediaService::attachPlayer(")) {
        meaning.kind = Meaning::Kind::kBorn;
        return;
    }
    if (text == "OrvMediaService::disconnect()") {
        meaning.kind = Meaning::Kind::kGone;
        return;
    }
    meaning.player = contains(text, "this=") ? readAddress(text) : 0;
    if (meaning.player == 0) return;
    if (endsWith(text, "callback application")) {
        meaning.kind = Meaning::Kind::kEnter;
        meaning.name = "callback";
    } else if (endsWith(text, "back from callback")) {
        meaning.kind = Meaning::Kind::kLeave;
        meaning.name = "callback";
    } else if (startsWith(text, "MEDIA_") || startsWith(text, "default,")) {
        meaning.event = text.substr(0, text.find(','));
        meaning.mark = meaning.event == "MEDIA_ERROR" ? Mark::kError : Mark::kEvent;
    }
}

// Lines of error priority that report no error.
bool onlySaysSo(std::string_view text) {
    return contains(text, "(): mLanguage") || startsWith(text, "width_new :") ||
           startsWith(text, "OrvMediaService::getDuration(): ") ||
           startsWith(text, "OrvMediaService::step(): amount = ");
}

// Failures that are logged at information priority.
bool saysFailure(std::string_view text) {
    return contains(text, "jniThrowException") || contains(text, "service get failed") ||
           contains(text, "service not exist") || contains(text, "error!!!!") ||
           contains(text, "() failed") || endsWith(text, "(): failed");
}

bool throws(std::string_view text) {
    return contains(text, "throw exception") || contains(text, "thow exception") ||
           contains(text, "jniThrowException") || contains(text, "is thrown");
}

void judge(const LogLine& line, Meaning& meaning) {
    if (meaning.kind != Meaning::Kind::kOther || meaning.mark != Mark::kNone) return;
    const bool error = line.priority == 'E' || line.priority == 'F';
    if ((error && !onlySaysSo(line.text)) || (!error && saysFailure(line.text))) {
        meaning.failure = true;
        meaning.mark = throws(line.text) ? Mark::kException : Mark::kError;
    } else if (line.priority == 'W') {
        meaning.mark = Mark::kWarning;
    }
}

}  // namespace

bool isOurs(std::string_view tag) {
    if (tag == kBridgeTag || tag == kServiceTag || tag == kDispatcherTag) return true;
    for (const std::string_view other : kOtherTags) {
        if (tag == other) return true;
    }
    return false;
}

Meaning meaningOf(const LogLine& line) {
    Meaning meaning;
    if (line.tag == kBridgeTag || line.tag == kDispatcherTag) {
        readSteps(line.text, meaning);
    } else if (line.tag == kServiceTag) {
        readServiceLine(line.text, meaning);
    }
    judge(line, meaning);
    return meaning;
}

}  // namespace orvtrace
