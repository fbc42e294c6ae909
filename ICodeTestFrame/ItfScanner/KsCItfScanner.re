// The scanner's rules. re2c turns this file into KsCItfScannerRules.cpp in the build tree; the
// rest of the scanner lives in KsCItfScanner.cpp.
//
// The automaton reads the text in place through re2c's generic input interface, so that every
// character it looks at passes one check: the token buffer holds kTokenBufferSize characters,
// and a token that makes the automaton read the character at that index from its start is
// refused, even when the token finally taken is shorter. Such a read yields the end-of-text
// sentinel, which no rule continues on, and raises a flag; the rule that is then taken sees the
// flag and reports the overflow instead of its token. Rules that cannot read that far (keywords,
// operators, white space, comment start) skip the check.
#include "ItfScanner/KsCItfScanner.h"

#include "ItfFactory/KsCItfFactory.h"
#include "ItfHostInterface/KsCMessageServer.h"
#include "ItfSrcRef/KsCItfParseInfo.h"
#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string_view>

namespace {

using Byte = unsigned char;

std::string_view textOf(const Byte* begin, const Byte* end) {
    return {reinterpret_cast<const char*>(begin), static_cast<std::size_t>(end - begin)};
}

void writeOut(std::FILE* out, const Byte* begin, const Byte* end) {
    if (out && begin != end)
        std::fwrite(begin, 1, static_cast<std::size_t>(end - begin), out);
}

int hexDigit(Byte c) {
    if (c >= '0' && c <= '9')
        return c - '0';
    if (c >= 'a' && c <= 'f')
        return c - 'a' + 10;
    if (c >= 'A' && c <= 'F')
        return c - 'A' + 10;
    return -1;
}

// "0x" followed by hex digits and an ignored suffix. Accumulated in a double: exact up to 2^53,
// rounded beyond, where C would have no type wide enough anyway.
double hexValue(const Byte* begin, const Byte* end) {
    double value = 0.0;
    for (const Byte* p = begin + 2; p != end; ++p) {
        int digit = hexDigit(*p);
        if (digit < 0)
            break;
        value = value * 16.0 + digit;
    }
    return value;
}

// Decimal integers and floating constants. The token is copied first: strtod must not read
// beyond it ("0x.8p1" scans as the constant 0 followed by other tokens, not as a hex float),
// and a refused token is never longer than the buffer.
double decimalValue(const Byte* begin, const Byte* end) {
    char copy[KsCItfScanner::kTokenBufferSize + 1];
    std::size_t length = static_cast<std::size_t>(end - begin);
    if (length > KsCItfScanner::kTokenBufferSize)
        length = KsCItfScanner::kTokenBufferSize;
    std::memcpy(copy, begin, length);
    copy[length] = '\0';
    return std::strtod(copy, nullptr);
}

// One character of a character constant, escapes resolved; `p` moves past it.
std::uint32_t literalCharacter(const Byte*& p) {
    Byte c = *p++;
    if (c != '\\')
        return c;
    c = *p++;
    switch (c) {
    case 'n':
        return '\n';
    case 't':
        return '\t';
    case 'r':
        return '\r';
    case 'a':
        return '\a';
    case 'b':
        return '\b';
    case 'f':
        return '\f';
    case 'v':
        return '\v';
    case 'x': {
        std::uint32_t value = 0;
        for (int digit; (digit = hexDigit(*p)) >= 0; ++p)
            value = (value << 4) | static_cast<std::uint32_t>(digit);
        return value;
    }
    default:
        break;
    }
    if (c >= '0' && c <= '7') {
        std::uint32_t value = c - '0';
        for (int i = 1; i < 3 && *p >= '0' && *p <= '7'; ++i, ++p)
            value = (value << 3) | static_cast<std::uint32_t>(*p - '0');
        return value;
    }
    // \\ \' \" \? stand for the character itself, and so does an unknown escape.
    return c;
}

// The value a C compiler for the host's targets (signed 8-bit char, 32-bit int and wchar_t)
// gives the constant: a single character is sign-extended from 8 bits, several characters are
// packed into an int, first character highest; a wide constant has its last character's value.
double characterValue(const Byte* begin, const Byte* end) {
    bool wide = *begin == 'L';
    const Byte* p = begin + (wide ? 2 : 1);
    const Byte* last = end - 1; // the closing quote
    std::uint32_t packed = 0;
    std::uint32_t lastCharacter = 0;
    int count = 0;
    while (p < last) {
        std::uint32_t c = literalCharacter(p);
        lastCharacter = c;
        packed = (packed << 8) | (c & 0xFFu);
        ++count;
    }
    if (wide)
        return static_cast<std::int32_t>(lastCharacter);
    if (count == 1)
        return static_cast<std::int8_t>(packed & 0xFFu);
    return static_cast<std::int32_t>(packed);
}

KsCItfString* makeString(std::string_view text) {
    KsCItfFactory* factory = theParseInfo ? theParseInfo->getFactory() : nullptr;
    if (!factory)
        return nullptr;
    KsCItfString* string = factory->createString();
    string->setText(ZnCXString(text));
    return string;
}

bool isTypeName(std::string_view text) {
    KsCItfTypeNameRegistry* registry = theParseInfo ? theParseInfo->getTypeNameRegistry() : nullptr;
    return registry && registry->isTypeName(text);
}

// Where the input goes after a refused token: nothing more is read from the file.
constexpr char kNoMoreInput[] = "";

} // namespace

int KsCItfScanner::lex() {
    line_ += pendingNewlines_;
    pendingNewlines_ = 0;
    pooledToken_ = nullptr;
    if (!cursor_) {
        token_ = nullptr;
        tokenLength_ = 0;
        return KsEItfToken::END_OF_INPUT;
    }

    const Byte* cur = reinterpret_cast<const Byte*>(cursor_);
    const Byte* tok = cur;
    const Byte* mar = cur;
    // Set when the automaton asked for the character at index kTokenBufferSize of the token.
    bool overflow = false;

    // A token without tab or newline: its length moves the column.
    auto accept = [&](int code) {
        token_ = reinterpret_cast<const char*>(tok);
        tokenLength_ = static_cast<std::size_t>(cur - tok);
        cursor_ = reinterpret_cast<const char*>(cur);
        theColumn += static_cast<int>(tokenLength_);
        return code;
    };
    // A literal, which may hold tabs and newlines; its newlines count at the next lex().
    auto acceptLiteral = [&](int code) {
        int column = theColumn;
        for (const Byte* p = tok; p != cur; ++p) {
            if (*p == '\n') {
                column = 0;
                ++pendingNewlines_;
            } else if (*p == '\t') {
                column = (column + 8) & ~7;
            } else {
                ++column;
            }
        }
        token_ = reinterpret_cast<const char*>(tok);
        tokenLength_ = static_cast<std::size_t>(cur - tok);
        cursor_ = reinterpret_cast<const char*>(cur);
        theColumn = column;
        return code;
    };
    // The refused token is reported where it starts; the file ends there for the parser.
    auto refuse = [&]() {
        token_ = reinterpret_cast<const char*>(tok);
        tokenLength_ = 0;
        cursor_ = kNoMoreInput;
        error("Token buffer overflow");
        return static_cast<int>(KsEItfToken::LEX_ERROR);
    };

    for (;;) {
        tok = cur;
        // clang-format off
        /*!re2c
            re2c:api = custom;
            re2c:api:style = free-form;
            re2c:define:YYCTYPE = "Byte";
            re2c:define:YYPEEK = "(cur - tok < kTokenBufferSize ? *cur : (overflow = true, Byte(0)))";
            re2c:define:YYSKIP = "++cur;";
            re2c:define:YYBACKUP = "mar = cur;";
            re2c:define:YYRESTORE = "cur = mar;";
            re2c:yyfill:enable = 0;
            re2c:sentinel = 0;
            re2c:indent:string = "    ";

            D  = [0-9];
            L  = [a-zA-Z_];
            H  = [a-fA-F0-9];
            E  = [Ee] [+-]? D+;
            FS = [fFlL];
            IS = [uUlL]*;
            // Literals hold 7-bit characters only; the end of the text ends them too.
            CHAR_ESCAPE = "\\" [^\n\x00\x80-\xff];

            "/*" {
                theColumn += 2;
                skipComment(cur);
                continue;
            }

            "sizeof"   { return accept(KsEItfToken::SIZEOF); }
            "typedef"  { return accept(KsEItfToken::TYPEDEF); }
            "extern"   { return accept(KsEItfToken::EXTERN); }
            "static"   { return accept(KsEItfToken::STATIC); }
            "auto"     { return accept(KsEItfToken::AUTO); }
            "register" { return accept(KsEItfToken::REGISTER); }
            "char"     { return accept(KsEItfToken::CHAR); }
            "short"    { return accept(KsEItfToken::SHORT); }
            "int"      { return accept(KsEItfToken::INT); }
            "long"     { return accept(KsEItfToken::LONG); }
            "signed"   { return accept(KsEItfToken::SIGNED); }
            "unsigned" { return accept(KsEItfToken::UNSIGNED); }
            "float"    { return accept(KsEItfToken::FLOAT); }
            "double"   { return accept(KsEItfToken::DOUBLE); }
            "const"    { return accept(KsEItfToken::CONST); }
            "volatile" { return accept(KsEItfToken::VOLATILE); }
            "void"     { return accept(KsEItfToken::VOID); }
            "struct"   { return accept(KsEItfToken::STRUCT); }
            "union"    { return accept(KsEItfToken::UNION); }
            "enum"     { return accept(KsEItfToken::ENUM); }
            "case"     { return accept(KsEItfToken::CASE); }
            "default"  { return accept(KsEItfToken::DEFAULT); }
            "if"       { return accept(KsEItfToken::IF); }
            "else"     { return accept(KsEItfToken::ELSE); }
            "switch"   { return accept(KsEItfToken::SWITCH); }
            "while"    { return accept(KsEItfToken::WHILE); }
            "do"       { return accept(KsEItfToken::DO); }
            "for"      { return accept(KsEItfToken::FOR); }
            "goto"     { return accept(KsEItfToken::GOTO); }
            "continue" { return accept(KsEItfToken::CONTINUE); }
            "break"    { return accept(KsEItfToken::BREAK); }
            "return"   { return accept(KsEItfToken::RETURN); }

            "ARG_INFO"     { return accept(KsEItfToken::ARG_INFO); }
            "IC_INFO"      { return accept(KsEItfToken::IC_INFO); }
            "LOOP_INFO"    { return accept(KsEItfToken::LOOP_INFO); }
            "SMB_INFO"     { return accept(KsEItfToken::SMB_INFO); }
            "IDX_INFO"     { return accept(KsEItfToken::IDX_INFO); }
            "GENERIC_LOOP" { return accept(KsEItfToken::GENERIC_LOOP); }
            "DEFINE_ITERATION_CONTEXT" { return accept(KsEItfToken::DEFINE_ITERATION_CONTEXT); }

            "MUL"          { return accept(KsEItfToken::OP_MUL); }
            "DIV"          { return accept(KsEItfToken::OP_DIV); }
            "MOD"          { return accept(KsEItfToken::OP_MOD); }
            "ADD"          { return accept(KsEItfToken::OP_ADD); }
            "SUB"          { return accept(KsEItfToken::OP_SUB); }
            "LEFT"         { return accept(KsEItfToken::OP_LEFT); }
            "RIGHT"        { return accept(KsEItfToken::OP_RIGHT); }
            "LESS"         { return accept(KsEItfToken::OP_LESS); }
            "GREATER"      { return accept(KsEItfToken::OP_GREATER); }
            "LE"           { return accept(KsEItfToken::OP_LE); }
            "GE"           { return accept(KsEItfToken::OP_GE); }
            "EQ"           { return accept(KsEItfToken::OP_EQ); }
            "NE"           { return accept(KsEItfToken::OP_NE); }
            "BITWISE_AND"  { return accept(KsEItfToken::OP_BITWISE_AND); }
            "XOR"          { return accept(KsEItfToken::OP_XOR); }
            "BITWISE_OR"   { return accept(KsEItfToken::OP_BITWISE_OR); }
            "AND"          { return accept(KsEItfToken::OP_AND); }
            "OR"           { return accept(KsEItfToken::OP_OR); }
            "COND"         { return accept(KsEItfToken::OP_COND); }
            "COMMA"        { return accept(KsEItfToken::OP_COMMA); }
            "ASSIGN"       { return accept(KsEItfToken::OP_ASSIGN); }
            "MUL_ASSIGN"   { return accept(KsEItfToken::OP_MUL_ASSIGN); }
            "DIV_ASSIGN"   { return accept(KsEItfToken::OP_DIV_ASSIGN); }
            "MOD_ASSIGN"   { return accept(KsEItfToken::OP_MOD_ASSIGN); }
            "ADD_ASSIGN"   { return accept(KsEItfToken::OP_ADD_ASSIGN); }
            "SUB_ASSIGN"   { return accept(KsEItfToken::OP_SUB_ASSIGN); }
            "LEFT_ASSIGN"  { return accept(KsEItfToken::OP_LEFT_ASSIGN); }
            "RIGHT_ASSIGN" { return accept(KsEItfToken::OP_RIGHT_ASSIGN); }
            "AND_ASSIGN"   { return accept(KsEItfToken::OP_AND_ASSIGN); }
            "XOR_ASSIGN"   { return accept(KsEItfToken::OP_XOR_ASSIGN); }
            "OR_ASSIGN"    { return accept(KsEItfToken::OP_OR_ASSIGN); }
            "REF"          { return accept(KsEItfToken::OP_REF); }
            "DEREF"        { return accept(KsEItfToken::OP_DEREF); }
            "U_PLUS"       { return accept(KsEItfToken::OP_U_PLUS); }
            "U_MINUS"      { return accept(KsEItfToken::OP_U_MINUS); }
            "COMPL"        { return accept(KsEItfToken::OP_COMPL); }
            "NOT"          { return accept(KsEItfToken::OP_NOT); }
            "CAST"         { return accept(KsEItfToken::OP_CAST); }
            "INC"          { return accept(KsEItfToken::OP_INC); }
            "DEC"          { return accept(KsEItfToken::OP_DEC); }

            L (L | D)* {
                if (overflow)
                    return refuse();
                std::string_view text = textOf(tok, cur);
                theTokenValue.string = makeString(text);
                return accept(isTypeName(text) ? KsEItfToken::TYPE_NAME : KsEItfToken::IDENTIFIER);
            }

            "0" [xX] H+ IS {
                if (overflow)
                    return refuse();
                theTokenValue.number = hexValue(tok, cur);
                return accept(KsEItfToken::CONSTANT);
            }
            "0" D+ IS
            | D+ IS
            | D+ E FS?
            | D* "." D+ E? FS?
            | D+ "." D* E? FS? {
                if (overflow)
                    return refuse();
                theTokenValue.number = decimalValue(tok, cur);
                return accept(KsEItfToken::CONSTANT);
            }
            "L"? "'" (CHAR_ESCAPE | [^\\'\x00\x80-\xff])+ "'" {
                if (overflow)
                    return refuse();
                theTokenValue.number = characterValue(tok, cur);
                return acceptLiteral(KsEItfToken::CONSTANT);
            }

            "L"? "\"" (CHAR_ESCAPE | [^\\"\x00\x80-\xff])* "\"" {
                if (overflow)
                    return refuse();
                theTokenValue.string = makeString(textOf(tok, cur));
                return acceptLiteral(KsEItfToken::STRING_LITERAL);
            }

            "..." { return accept(KsEItfToken::ELLIPSIS); }
            ">>=" { return accept(KsEItfToken::RIGHT_ASSIGN); }
            "<<=" { return accept(KsEItfToken::LEFT_ASSIGN); }
            "+="  { return accept(KsEItfToken::ADD_ASSIGN); }
            "-="  { return accept(KsEItfToken::SUB_ASSIGN); }
            "*="  { return accept(KsEItfToken::MUL_ASSIGN); }
            "/="  { return accept(KsEItfToken::DIV_ASSIGN); }
            "%="  { return accept(KsEItfToken::MOD_ASSIGN); }
            "&="  { return accept(KsEItfToken::AND_ASSIGN); }
            "^="  { return accept(KsEItfToken::XOR_ASSIGN); }
            "|="  { return accept(KsEItfToken::OR_ASSIGN); }
            ">>"  { return accept(KsEItfToken::RIGHT_OP); }
            "<<"  { return accept(KsEItfToken::LEFT_OP); }
            "++"  { return accept(KsEItfToken::INC_OP); }
            "--"  { return accept(KsEItfToken::DEC_OP); }
            "->"  { return accept(KsEItfToken::PTR_OP); }
            "&&"  { return accept(KsEItfToken::AND_OP); }
            "||"  { return accept(KsEItfToken::OR_OP); }
            "<="  { return accept(KsEItfToken::LE_OP); }
            ">="  { return accept(KsEItfToken::GE_OP); }
            "=="  { return accept(KsEItfToken::EQ_OP); }
            "!="  { return accept(KsEItfToken::NE_OP); }

            [;{},:=()[\].&!~\-+*/%<>^|?] { return accept(*tok); }
            "<%" { return accept('{'); }
            "%>" { return accept('}'); }
            "<:" { return accept('['); }
            ":>" { return accept(']'); }

            [ \t\v\f\n] {
                skipWhitespace(tok, cur);
                continue;
            }

            "\x00" {
                // The end of the text is final: the cursor stays on the NUL.
                cur = tok;
                return accept(KsEItfToken::END_OF_INPUT);
            }

            // No rule takes bytes of 128 or more; a run of them passes through to the output.
            [\x80-\xff] {
                while (*cur >= 0x80)
                    ++cur;
                writeOut(KS_GetScannerOutput(), tok, cur);
                continue;
            }

            // Any other character, and a quote that begins no complete literal, is ignored
            // without moving the column.
            * {
                if (overflow)
                    return refuse();
                continue;
            }
        */
        // clang-format on
    }
}

// Comment bodies are not part of any token: their newlines count at once, their characters
// do not move the column. The body goes to the scanner output without its '*' characters,
// followed by the closing '/'.
void KsCItfScanner::skipComment(const unsigned char*& cur) {
    std::FILE* out = KS_GetScannerOutput();
    const Byte* run = cur;
    for (;;) {
        Byte c = *cur;
        if (c == '*') {
            writeOut(out, run, cur);
            ++cur;
            if (*cur == '/') {
                writeOut(out, cur, cur + 1);
                ++cur;
                return;
            }
            run = cur;
        } else if (c == '\0') {
            // An unterminated comment ends with the text.
            writeOut(out, run, cur);
            return;
        } else {
            if (c == '\n')
                ++line_;
            ++cur;
        }
    }
}

// White space is a token of its own per character; a run of it is taken in one loop, which
// moves column and line exactly as the single-character tokens would.
void KsCItfScanner::skipWhitespace(const unsigned char* from, const unsigned char*& cur) {
    int column = theColumn;
    const Byte* p = from;
    for (;; ++p) {
        Byte c = *p;
        if (c == ' ' || c == '\v' || c == '\f') {
            ++column;
        } else if (c == '\t') {
            column = (column + 8) & ~7;
        } else if (c == '\n') {
            column = 0;
            ++line_;
        } else {
            break;
        }
    }
    theColumn = column;
    cur = p;
}
