#include "ItfHostInterface/ZnCXString.h"

#include <cstdio>
#include <cstring>

ZnCXString::ZnCXString(const char* text) : text_(text ? text : "") {}
ZnCXString::ZnCXString(const char* text, std::size_t length) : text_(text, length) {}
ZnCXString::ZnCXString(int number) : text_(std::to_string(number)) {}
ZnCXString::ZnCXString(long long number) : text_(std::to_string(number)) {}

ZnCXString::ZnCXString(double number) {
    char buffer[64];
    std::snprintf(buffer, sizeof buffer, "%.17g", number);
    // The shortest text that reads back as the same double.
    for (int precision = 1; precision <= 17; ++precision) {
        char shorter[64];
        std::snprintf(shorter, sizeof shorter, "%.*g", precision, number);
        if (std::strtod(shorter, nullptr) == number) {
            text_ = shorter;
            return;
        }
    }
    text_ = buffer;
}

int ZnCXString::compareWith(const ZnCXString& other) const {
    int order = text_.compare(other.text_);
    return order < 0 ? -1 : order > 0 ? 1 : 0;
}

bool ZnCXString::startsWith(const ZnCXString& prefix) const {
    return text_.starts_with(prefix.text_);
}

ZnCXString ZnCXString::head(std::size_t count) const {
    return ZnCXString(text_.substr(0, count));
}

ZnCXString ZnCXString::tail(std::size_t count) const {
    return count >= text_.size() ? *this : ZnCXString(text_.substr(text_.size() - count));
}

std::vector<ZnCXString> ZnCXString::split(char separator) const {
    std::vector<ZnCXString> pieces;
    std::size_t start = 0;
    for (;;) {
        std::size_t end = text_.find(separator, start);
        if (end == std::string::npos) {
            pieces.emplace_back(text_.substr(start));
            return pieces;
        }
        pieces.emplace_back(text_.substr(start, end - start));
        start = end + 1;
    }
}

ZnCXString ZnCXString::replaceAll(const ZnCXString& from, const ZnCXString& to) const {
    if (from.text_.empty())
        return *this;
    std::string result;
    std::size_t start = 0;
    for (;;) {
        std::size_t found = text_.find(from.text_, start);
        if (found == std::string::npos)
            break;
        result.append(text_, start, found - start);
        result += to.text_;
        start = found + from.text_.size();
    }
    result.append(text_, start, std::string::npos);
    return ZnCXString(std::move(result));
}

ZnCXString& ZnCXString::operator+=(const ZnCXString& other) {
    text_ += other.text_;
    return *this;
}

ZnCXString& ZnCXString::operator+=(const char* other) {
    if (other)
        text_ += other;
    return *this;
}

ZnCXString& ZnCXString::operator+=(char c) {
    text_ += c;
    return *this;
}

ZnCXString& ZnCXString::operator+=(int number) {
    text_ += std::to_string(number);
    return *this;
}

ZnCXString operator+(const ZnCXString& a, const ZnCXString& b) {
    ZnCXString result(a);
    result += b;
    return result;
}

ZnCXString operator+(const ZnCXString& a, const char* b) {
    ZnCXString result(a);
    result += b;
    return result;
}

ZnCXString operator+(const char* a, const ZnCXString& b) {
    ZnCXString result(a);
    result += b;
    return result;
}

ZnCXString operator+(const ZnCXString& a, int number) {
    ZnCXString result(a);
    result += number;
    return result;
}
