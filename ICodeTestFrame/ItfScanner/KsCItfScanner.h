// The scanner: cuts the text of one test file into the tokens of the test-file language.
// Longest match wins, and among matches of equal length the rule listed first; the automaton
// is generated from the rule file KsCItfScanner.re.
#pragma once

#include "ItfBase/KsCItfMemory.h"
#include "ItfScanner/KsCItfToken.h"

#include <cstddef>

class KsCItfScanner : public KsCItfObject {
public:
    // Capacity of the token buffer of the original automaton: a token that needs the automaton
    // to read 100 characters or more from its start is refused ("Token buffer overflow").
    static constexpr int kTokenBufferSize = 100;

    // A new scanner starts at line 1 and column 0.
    KsCItfScanner();
    virtual ~KsCItfScanner() = default;

    // The file's text, NUL-terminated; it stays owned by the caller during the parse.
    void setInput(const char* text);

    // The next token code, 0 at the end of the input; theTokenValue holds the value of
    // CONSTANT, IDENTIFIER, TYPE_NAME and STRING_LITERAL. After an error of its own (a token
    // buffer overflow) the scanner has reported it and answers LEX_ERROR; the rest of the file
    // is not scanned, later calls answer 0.
    int lex();

    // Reports `text` as a syntax error of the current file at the current line and column and
    // clears the parse info's success flag; the parse goes on until the parser stops it.
    virtual void error(const char* text);

    // The line of the current token's first character.
    int getLine() const { return line_; }
    // The current token's text, pooled in the node factory of the parse info.
    const char* getTokenText();

private:
    void skipComment(const unsigned char*& cur);
    void skipWhitespace(const unsigned char* from, const unsigned char*& cur);

    const char* cursor_ = nullptr; // first unread character
    const char* token_ = nullptr;  // start of the current token
    std::size_t tokenLength_ = 0;
    int line_ = 1;
    int pendingNewlines_ = 0; // newlines of the current token, added at the next lex()
    const char* pooledToken_ = nullptr;
};
