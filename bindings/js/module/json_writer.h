#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace vorelscript {

/// Writes one JSON text, from the front to the back.
class JsonWriter {
  public:
    JsonWriter& beginObject() { return begin('{'); }
    JsonWriter& endObject() { return end('}'); }
    JsonWriter& beginArray() { return begin('['); }
    JsonWriter& endArray() { return end(']'); }

    /// Of the value that is written next.
    JsonWriter& key(std::string_view name);

    /// Bytes that are not UTF-8 stay as they are.
    JsonWriter& value(std::string_view text);
    JsonWriter& value(const char* text) { return value(std::string_view(text)); }
    JsonWriter& value(bool truth);
    JsonWriter& value(int number);
    JsonWriter& value(size_t number);
    JsonWriter& value(double number);
    JsonWriter& value(float number);
    JsonWriter& value(const std::vector<std::string>& texts);

    template <typename Value>
    JsonWriter& entry(std::string_view name, const Value& of) {
        return key(name).value(of);
    }

    const std::string& text() const { return mText; }

  private:
    JsonWriter& begin(char bracket);
    JsonWriter& end(char bracket);
    JsonWriter& raw(std::string_view spelling);
    void separate();
    void quote(std::string_view text);

    std::string mText;
    bool mIsFirst = true;  ///< nothing stands before the next value in its list
};

}  // namespace vorelscript
