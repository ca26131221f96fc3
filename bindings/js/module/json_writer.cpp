#include "json_writer.h"

#include "style/vorelstyle.h"

namespace vorelscript {

JsonWriter& JsonWriter::key(std::string_view name) {
    separate();
    quote(name);
    mText += ':';
    mIsFirst = true;
    return *this;
}

JsonWriter& JsonWriter::value(std::string_view text) {
    separate();
    quote(text);
    return *this;
}

JsonWriter& JsonWriter::value(bool truth) {
    return raw(truth ? "true" : "false");
}

JsonWriter& JsonWriter::value(int number) {
    return raw(std::to_string(number));
}

JsonWriter& JsonWriter::value(size_t number) {
    return raw(std::to_string(number));
}

JsonWriter& JsonWriter::value(double number) {
    return raw(vorelstyle::spelled(number));
}

JsonWriter& JsonWriter::value(float number) {
    return raw(vorelstyle::spelled(number));
}

JsonWriter& JsonWriter::value(const std::vector<std::string>& texts) {
    beginArray();
    for (const std::string& text : texts)
        value(text);
    return endArray();
}

JsonWriter& JsonWriter::begin(char bracket) {
    separate();
    mText += bracket;
    mIsFirst = true;
    return *this;
}

JsonWriter& JsonWriter::end(char bracket) {
    mText += bracket;
    mIsFirst = false;
    return *this;
}

JsonWriter& JsonWriter::raw(std::string_view spelling) {
    separate();
    mText += spelling;
    return *this;
}

void JsonWriter::separate() {
    if (!mIsFirst) mText += ',';
    mIsFirst = false;
}

void JsonWriter::quote(std::string_view text) {
    constexpr const char* kDigits = "0123456789abcdef";
    mText += '"';
    for (const char each : text) {
        const auto byte = static_cast<unsigned char>(each);
        if (byte < 0x20) {
            mText.append("\\u00").append(1, kDigits[byte >> 4]).append(1, kDigits[byte & 15]);
            continue;
        }
        if (each == '"' || each == '\\') mText += '\\';
        mText += each;
    }
    mText += '"';
}

}  // namespace vorelscript
