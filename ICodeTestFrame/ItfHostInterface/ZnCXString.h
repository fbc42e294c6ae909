// The host's string class: every name, file name, property value and message text passes as one.
#pragma once

#include "KsHostApi.h"

#include <string>
#include <string_view>
#include <vector>

class KS_HOST_API ZnCXString {
public:
    ZnCXString() = default;
    ZnCXString(const char* text);
    ZnCXString(const char* text, std::size_t length);
    ZnCXString(std::string text) : text_(std::move(text)) {}
    explicit ZnCXString(std::string_view text) : text_(text) {}
    explicit ZnCXString(int number);
    explicit ZnCXString(long long number);
    explicit ZnCXString(double number);

    std::size_t length() const { return text_.size(); }
    bool isEmpty() const { return text_.empty(); }
    const char* cstring() const { return text_.c_str(); }
    const std::string& str() const { return text_; }
    std::string_view view() const { return text_; }
    char operator[](std::size_t index) const { return text_[index]; }

    // Negative, zero or positive, as strcmp orders the texts.
    int compareWith(const ZnCXString& other) const;
    bool startsWith(const ZnCXString& prefix) const;
    // The first / last `count` characters; the whole text when it is shorter.
    ZnCXString head(std::size_t count) const;
    ZnCXString tail(std::size_t count) const;
    // The pieces between occurrences of `separator`; one piece when it does not occur.
    std::vector<ZnCXString> split(char separator) const;
    ZnCXString replaceAll(const ZnCXString& from, const ZnCXString& to) const;

    ZnCXString& operator+=(const ZnCXString& other);
    ZnCXString& operator+=(const char* other);
    ZnCXString& operator+=(char c);
    ZnCXString& operator+=(int number);

    friend bool operator==(const ZnCXString& a, const ZnCXString& b) { return a.text_ == b.text_; }
    friend bool operator==(const ZnCXString& a, const char* b) { return a.text_ == b; }

private:
    std::string text_;
};

KS_HOST_API ZnCXString operator+(const ZnCXString& a, const ZnCXString& b);
KS_HOST_API ZnCXString operator+(const ZnCXString& a, const char* b);
KS_HOST_API ZnCXString operator+(const char* a, const ZnCXString& b);
KS_HOST_API ZnCXString operator+(const ZnCXString& a, int number);
