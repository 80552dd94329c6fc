// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <rapidjson/filewritestream.h>
#include <rapidjson/writer.h>
#include <stdio.h>

#include <cstdint>
#include <string_view>
#include <vector>

namespace orvtrace {

// JSON into an open file, by a buffer of fixed size. Texts that are no UTF-8 are made it.
class Json {
public:
    explicit Json(FILE* file);
    Json(const Json&) = delete;
    Json& operator=(const Json&) = delete;

    void beginObject() { mWriter.StartObject(); }
    void endObject() { mWriter.EndObject(); }
    void beginArray() { mWriter.StartArray(); }
    void endArray() { mWriter.EndArray(); }
    void key(std::string_view name) { mWriter.Key(name.data(), size(name)); }
    void text(std::string_view text);
    void number(int64_t number) { mWriter.Int64(number); }
    void truth(bool truth) { mWriter.Bool(truth); }
    // Nanoseconds as microseconds, exactly.
    void microseconds(int64_t nanoseconds);
    // After the last value.
    void flush() { mStream.Flush(); }

    void pair(std::string_view name, std::string_view value) {
        key(name);
        text(value);
    }
    void pair(std::string_view name, int64_t value) {
        key(name);
        number(value);
    }

private:
    static rapidjson::SizeType size(std::string_view text) {
        return static_cast<rapidjson::SizeType>(text.size());
    }

    std::vector<char> mBuffer;
    rapidjson::FileWriteStream mStream;
    rapidjson::Writer<rapidjson::FileWriteStream> mWriter;
};

}  // namespace orvtrace
