#include "ItfScanner/KsCItfScanner.h"
#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfParser/KsCItfParseSession.h"
#include "ItfSrcRef/KsCItfParseInfo.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfTestSupport.h"
#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"
#include "KsCHostSrcRefServer.h"

#include <cctype>
#include <cstdio>
#include <cstring>
#include <memory>
#include <optional>
#include <random>
#include <set>
#include <string>
#include <vector>

namespace {

namespace T = KsEItfToken;

struct NamedToken {
    const char* name;
    int code;
    const char* spelling;
};

const NamedToken kNamedTokens[] = {
#define ITF_TOKEN(Name, Code, Spelling) {#Name, Code, Spelling},
#include "ItfScanner/KsCItfTokens.def"
#undef ITF_TOKEN
};

// What the parser can see of one token.
struct Token {
    int code = 0;
    std::string text; // getTokenText()
    int line = 0;
    int column = 0;
    double number = 0.0;              // CONSTANT
    std::optional<std::string> value; // string node of IDENTIFIER, TYPE_NAME, STRING_LITERAL
    const KsCItfString* node = nullptr;
};

class KsCItfScannerTest : public ItfHostTest {
protected:
    void SetUp() override {
        ItfHostTest::SetUp();
        srcRefServer.init(&hostSrcRefs);
        reporter.init(&srcRefServer, &factory);
        registry.init(nullptr, &reporter);
        session.emplace(&factory, &reporter, &registry);
        session->info().setFileName("unit");
    }
    void TearDown() override {
        session.reset();
        KsCHostMessageServer::setScannerOutput(nullptr);
        if (output_)
            std::fclose(output_);
        scanner_.reset();
        registry.exit();
        factory.exit();
        srcRefServer.exit();
        ItfHostTest::TearDown();
    }

    // A new scanner over `text`. The copy is exactly as long as the text and its NUL, so that
    // the sanitizer build catches any read beyond it.
    KsCItfScanner& start(const std::string& text) {
        input_ = std::make_unique<char[]>(text.size() + 1);
        std::memcpy(input_.get(), text.data(), text.size());
        input_[text.size()] = '\0';
        scanner_.emplace();
        scanner_->setInput(input_.get());
        return *scanner_;
    }

    Token next() {
        Token t;
        t.code = scanner_->lex();
        t.text = scanner_->getTokenText();
        t.line = scanner_->getLine();
        t.column = theColumn;
        if (t.code == T::CONSTANT)
            t.number = theTokenValue.number;
        if (t.code == T::IDENTIFIER || t.code == T::TYPE_NAME || t.code == T::STRING_LITERAL) {
            t.node = theTokenValue.string;
            if (t.node)
                t.value = t.node->getText().str();
        }
        return t;
    }

    // All tokens up to the end of the input (not included) or up to and including LEX_ERROR.
    std::vector<Token> scan(std::string text) {
        std::size_t bound = text.size() + 2;
        start(std::move(text));
        std::vector<Token> tokens;
        for (std::size_t i = 0; i < bound; ++i) {
            Token t = next();
            if (t.code == T::END_OF_INPUT)
                return tokens;
            tokens.push_back(t);
            if (t.code == T::LEX_ERROR)
                return tokens;
        }
        ADD_FAILURE() << "the scanner did not reach the end of its input";
        return tokens;
    }

    std::vector<int> codes(std::string text) {
        std::vector<int> out;
        for (const Token& t : scan(std::move(text)))
            out.push_back(t.code);
        return out;
    }

    // Makes a temporary file the scanner output; outputText() reads what reached it.
    void captureOutput() {
        output_ = std::tmpfile();
        ASSERT_NE(output_, nullptr);
        KsCHostMessageServer::setScannerOutput(output_);
    }
    std::string outputText() {
        std::fflush(output_);
        std::rewind(output_);
        std::string out;
        for (int c; (c = std::fgetc(output_)) != EOF;)
            out += static_cast<char>(c);
        return out;
    }

    KsCHostSrcRefServer hostSrcRefs;
    KsCItfSrcRefServer srcRefServer;
    KsCItfFactory factory;
    KsCItfMessages reporter;
    KsCItfTypeNameRegistry registry;
    std::optional<KsCItfParseSession> session;

private:
    std::unique_ptr<char[]> input_;
    std::optional<KsCItfScanner> scanner_;
    std::FILE* output_ = nullptr;
};

bool isWord(const char* spelling) {
    return std::isalpha(static_cast<unsigned char>(spelling[0])) || spelling[0] == '_';
}

// --- Keywords, identifiers, type names -----------------------------------------------------

TEST_F(KsCItfScannerTest, EveryNamedTokenScansFromItsSpelling) {
    int checked = 0;
    for (const NamedToken& named : kNamedTokens) {
        if (named.code < T::SIZEOF)
            continue; // IDENTIFIER ... TYPE_NAME are classes, not spellings
        std::vector<Token> tokens = scan(named.spelling);
        ASSERT_EQ(tokens.size(), 1u) << named.name;
        EXPECT_EQ(tokens[0].code, named.code) << named.name;
        EXPECT_EQ(tokens[0].text, named.spelling) << named.name;
        EXPECT_EQ(tokens[0].column, static_cast<int>(std::string(named.spelling).size()));
        ++checked;
    }
    EXPECT_EQ(checked, 361 - 261 + 1);
}

TEST_F(KsCItfScannerTest, KeywordsNeedTheirExactSpelling) {
    std::set<std::string> spellings;
    for (const NamedToken& named : kNamedTokens)
        spellings.insert(named.spelling);
    for (const NamedToken& named : kNamedTokens) {
        if (named.code < T::SIZEOF || !isWord(named.spelling))
            continue;
        std::string longer = std::string(named.spelling) + "x";
        std::string otherCase = named.spelling;
        otherCase[0] = static_cast<char>(std::isupper(static_cast<unsigned char>(otherCase[0]))
                                             ? std::tolower(otherCase[0])
                                             : std::toupper(otherCase[0]));
        for (const std::string& word : {longer, otherCase, std::string("_") + named.spelling}) {
            if (spellings.count(word))
                continue;
            std::vector<Token> tokens = scan(word);
            ASSERT_EQ(tokens.size(), 1u) << word;
            EXPECT_EQ(tokens[0].code, T::IDENTIFIER) << word;
            EXPECT_EQ(tokens[0].value, word);
        }
    }
}

struct WordCase {
    const char* text;
    int unregistered;
    int registered; // after INT, SMB_INFOx, int, SMB_INFO and MUL became type names
};

TEST_F(KsCItfScannerTest, TypeNamesComeFromTheRegistryButNeverShadowKeywords) {
    const WordCase cases[] = {
        {"integer", T::IDENTIFIER, T::IDENTIFIER},  {"int", T::INT, T::INT},
        {"INT", T::IDENTIFIER, T::TYPE_NAME},       {"Int", T::IDENTIFIER, T::IDENTIFIER},
        {"SMB_INFO", T::SMB_INFO, T::SMB_INFO},     {"SMB_INFOx", T::IDENTIFIER, T::TYPE_NAME},
        {"smb_info", T::IDENTIFIER, T::IDENTIFIER}, {"MUL", T::OP_MUL, T::OP_MUL},
        {"L", T::IDENTIFIER, T::IDENTIFIER},        {"_9", T::IDENTIFIER, T::IDENTIFIER},
    };
    for (const WordCase& c : cases) {
        std::vector<Token> tokens = scan(c.text);
        ASSERT_EQ(tokens.size(), 1u) << c.text;
        EXPECT_EQ(tokens[0].code, c.unregistered) << c.text;
    }
    for (const char* name : {"INT", "SMB_INFOx", "int", "SMB_INFO", "MUL"})
        registry.addTypeName(name);
    for (const WordCase& c : cases) {
        std::vector<Token> tokens = scan(c.text);
        ASSERT_EQ(tokens.size(), 1u) << c.text;
        EXPECT_EQ(tokens[0].code, c.registered) << c.text;
        if (c.registered == T::TYPE_NAME || c.registered == T::IDENTIFIER) {
            EXPECT_EQ(tokens[0].value, c.text);
        }
    }
}

TEST_F(KsCItfScannerTest, OperationKeywordsAreWordsNotOperators) {
    EXPECT_EQ(codes("MUL_ASSIGN *= OR_ASSIGN |= LEFT << INC ++"),
              (std::vector<int>{T::OP_MUL_ASSIGN, T::MUL_ASSIGN, T::OP_OR_ASSIGN, T::OR_ASSIGN,
                                T::OP_LEFT, T::LEFT_OP, T::OP_INC, T::INC_OP}));
}

TEST_F(KsCItfScannerTest, StringNodesAreMadeByTheFactoryForWordsAndStringsOnly) {
    registry.addTypeName("T");
    std::size_t before = factory.objectCount();
    std::vector<Token> tokens = scan("int a = 1 + 'c' ; \"s\" T ... /* c */ sizeof");
    ASSERT_EQ(tokens.size(), 11u);
    EXPECT_EQ(factory.objectCount() - before, 3u);
    std::set<const KsCItfString*> nodes;
    for (const Token& t : tokens)
        if (t.node)
            nodes.insert(t.node);
    EXPECT_EQ(nodes.size(), 3u);
    EXPECT_EQ(tokens[1].value, "a");
    EXPECT_EQ(tokens[7].value, "\"s\"");
    EXPECT_EQ(tokens[8].code, T::TYPE_NAME);
    EXPECT_EQ(tokens[8].value, "T");
}

// --- Operators ---------------------------------------------------------------------------------

struct Sequence {
    const char* text;
    std::vector<int> codes;
};

TEST_F(KsCItfScannerTest, OperatorsTakeTheLongestMatch) {
    const Sequence cases[] = {
        {"a+=b", {T::IDENTIFIER, T::ADD_ASSIGN, T::IDENTIFIER}},
        {"x>>=1", {T::IDENTIFIER, T::RIGHT_ASSIGN, T::CONSTANT}},
        {"x>>1", {T::IDENTIFIER, T::RIGHT_OP, T::CONSTANT}},
        {"x>1", {T::IDENTIFIER, '>', T::CONSTANT}},
        {"a<<=b<=c<d",
         {T::IDENTIFIER, T::LEFT_ASSIGN, T::IDENTIFIER, T::LE_OP, T::IDENTIFIER, '<',
          T::IDENTIFIER}},
        {"<:", {'['}},
        {":>", {']'}},
        {"<%%>", {'{', '}'}},
        {"a<:1:>", {T::IDENTIFIER, '[', T::CONSTANT, ']'}},
        {"%=%>%", {T::MOD_ASSIGN, '}', '%'}},
        {"...", {T::ELLIPSIS}},
        {"..", {'.', '.'}},
        {"....", {T::ELLIPSIS, '.'}},
        {"->", {T::PTR_OP}},
        {"p->q", {T::IDENTIFIER, T::PTR_OP, T::IDENTIFIER}},
        {"x--->y", {T::IDENTIFIER, T::DEC_OP, T::PTR_OP, T::IDENTIFIER}},
        {"a+++b", {T::IDENTIFIER, T::INC_OP, '+', T::IDENTIFIER}},
        {"&&&|||", {T::AND_OP, '&', T::OR_OP, '|'}},
        {"!===", {T::NE_OP, T::EQ_OP}},
        {"^=&=|=*=/=-=",
         {T::XOR_ASSIGN, T::AND_ASSIGN, T::OR_ASSIGN, T::MUL_ASSIGN, T::DIV_ASSIGN, T::SUB_ASSIGN}},
        {";{},:=()[].&!~-+*/%<>^|?", {';', '{', '}', ',', ':', '=', '(', ')', '[', ']', '.', '&',
                                      '!', '~', '-', '+', '*', '/', '%', '<', '>', '^', '|', '?'}},
        {"a.b", {T::IDENTIFIER, '.', T::IDENTIFIER}},
    };
    for (const Sequence& c : cases)
        EXPECT_EQ(codes(c.text), c.codes) << c.text;
}

// --- Constants -------------------------------------------------------------------------------

struct Value {
    const char* text;
    double value;
};

TEST_F(KsCItfScannerTest, ConstantsHaveTheirCValue) {
    const Value cases[] = {
        {"12", 12.0},
        {"0", 0.0},
        {"012", 12.0},
        {"089", 89.0},
        {"0x1F", 31.0},
        {"0X1f", 31.0},
        {"0xffUL", 255.0},
        {"0x10000000000", 1099511627776.0},
        {"10UL", 10.0},
        {"10u", 10.0},
        {"7lLuU", 7.0},
        {"1.5e3f", 1500.0},
        {".5", 0.5},
        {"5.", 5.0},
        {"2.5L", 2.5},
        {"1e3", 1000.0},
        {"1E-2", 0.01},
        {"1.e+2", 100.0},
        {".25e1F", 2.5},
        {"007.5", 7.5},
        {"'a'", 97.0},
        {"L'a'", 97.0},
        {"' '", 32.0},
        {"'\"'", 34.0},
        {"'\\n'", 10.0},
        {"'\\t'", 9.0},
        {"'\\r'", 13.0},
        {"'\\a'", 7.0},
        {"'\\b'", 8.0},
        {"'\\f'", 12.0},
        {"'\\v'", 11.0},
        {"'\\\\'", 92.0},
        {"'\\''", 39.0},
        {"'\\\"'", 34.0},
        {"'\\?'", 63.0},
        {"'\\0'", 0.0},
        {"'\\101'", 65.0},
        {"'\\7'", 7.0},
        {"'\\x41'", 65.0},
        {"'\\x7e'", 126.0},
        {"'\\177'", 127.0},
        {"'\\377'", -1.0},
        {"'\\xff'", -1.0},
        {"'ab'", 24930.0},
        {"'\\1011'", 16689.0},
        {"L'\\xff'", 255.0},
        {"L'\\x263a'", 9786.0},
    };
    for (const Value& c : cases) {
        std::vector<Token> tokens = scan(c.text);
        ASSERT_EQ(tokens.size(), 1u) << c.text;
        EXPECT_EQ(tokens[0].code, T::CONSTANT) << c.text;
        EXPECT_DOUBLE_EQ(tokens[0].number, c.value) << c.text;
        EXPECT_EQ(tokens[0].text, c.text);
    }
}

TEST_F(KsCItfScannerTest, ConstantValuesStopAtTheTokenEnd) {
    // "0x" without a hex digit is the constant 0; its value must not be read as a hex float.
    std::vector<Token> tokens = scan("0x.8p1");
    ASSERT_EQ(tokens.size(), 4u);
    EXPECT_EQ(tokens[0].code, T::CONSTANT);
    EXPECT_EQ(tokens[0].text, "0");
    EXPECT_EQ(tokens[0].number, 0.0);
    EXPECT_EQ(tokens[1].value, "x");
    EXPECT_EQ(tokens[2].text, ".8");
    EXPECT_DOUBLE_EQ(tokens[2].number, 0.8);
    EXPECT_EQ(tokens[3].value, "p1");

    EXPECT_EQ(codes("1e+x"), (std::vector<int>{T::CONSTANT, T::IDENTIFIER, '+', T::IDENTIFIER}));
    tokens = scan("1..2");
    ASSERT_EQ(tokens.size(), 2u);
    EXPECT_EQ(tokens[0].number, 1.0);
    EXPECT_DOUBLE_EQ(tokens[1].number, 0.2);
}

// --- Strings -----------------------------------------------------------------------------------

TEST_F(KsCItfScannerTest, StringLiteralsKeepQuotesAndPrefix) {
    for (const char* text : {"\"ab\"", "\"\"", "L\"ab\"", "\"a\\\"b\"", "\"a'b\"", "\"tab\there\"",
                             "\"two\nlines\""}) {
        std::vector<Token> tokens = scan(text);
        ASSERT_EQ(tokens.size(), 1u) << text;
        EXPECT_EQ(tokens[0].code, T::STRING_LITERAL) << text;
        EXPECT_EQ(tokens[0].value, text);
        EXPECT_EQ(tokens[0].text, text);
    }
    std::vector<Token> tokens = scan("\"a\" \"b\"");
    ASSERT_EQ(tokens.size(), 2u);
    EXPECT_EQ(tokens[0].value, "\"a\"");
    EXPECT_EQ(tokens[1].value, "\"b\"");
}

// --- Columns and lines ---------------------------------------------------------------------------

struct Columns {
    const char* text;
    std::vector<int> columns; // theColumn after each token
};

TEST_F(KsCItfScannerTest, ColumnsCountCharactersWithTabStops) {
    const Columns cases[] = {
        {"abc\tx", {3, 9}},         {"\tx", {9}},
        {"1234567\tx", {7, 9}},     {"12345678\tx", {8, 17}},
        {"a\n  b", {1, 3}},         {"ab\rcd", {2, 4}},
        {"ab\r\ncd", {2, 2}},       {"a\v\fb", {1, 4}},
        {"a /* body */ b", {1, 6}}, {"#$a", {1}},
        {"\"\t\" x", {9, 11}},      {"\"ab\ncde\" x", {4, 6}},
        {"'\n' x", {1, 3}},
    };
    for (const Columns& c : cases) {
        std::vector<int> columns;
        for (const Token& t : scan(c.text))
            columns.push_back(t.column);
        EXPECT_EQ(columns, c.columns) << c.text;
    }
}

TEST_F(KsCItfScannerTest, ANewScannerStartsAtColumnZero) {
    scan("abc");
    ASSERT_EQ(theColumn, 3);
    std::vector<Token> tokens = scan("x");
    ASSERT_EQ(tokens.size(), 1u);
    EXPECT_EQ(tokens[0].column, 1);
}

TEST_F(KsCItfScannerTest, LinesAreThoseOfTheTokensFirstCharacter) {
    std::vector<Token> tokens = scan("a\n\"x\ny\nz\" b\r\nc /* one\ntwo\n */ d\n'\n' e");
    ASSERT_EQ(tokens.size(), 7u);
    std::vector<int> lines;
    for (const Token& t : tokens)
        lines.push_back(t.line);
    // The string literal spans lines 2-4; the comment lines 5-7; the character constant 8-9.
    EXPECT_EQ(lines, (std::vector<int>{1, 2, 4, 5, 7, 8, 9}));
    // A comment's newlines do not reset the column: "c /*" counted, the body not.
    EXPECT_EQ(tokens[4].column, 6);
}

TEST_F(KsCItfScannerTest, SyntaxErrorIsReportedAtTheTokenStartLineAndItsEndColumn) {
    KsCItfScanner& scanner = start("\n\n\n  \"abc\n0123456789abcdef\" next");
    ASSERT_EQ(scanner.lex(), T::STRING_LITERAL);
    scanner.error("Syntax error");
    ASSERT_EQ(texts(), (std::vector<std::string>{"ICode test frame error: Syntax error in file "
                                                 "unit, line 4, column 17: Syntax error"}));
    EXPECT_FALSE(session->info().isSuccess());
    ASSERT_EQ(scanner.lex(), T::IDENTIFIER);
    EXPECT_EQ(scanner.getLine(), 5);
}

// --- The token buffer --------------------------------------------------------------------------

struct Boundary {
    std::string text;
    std::vector<int> codes;
};

TEST_F(KsCItfScannerTest, TheAutomatonNeverReadsTheHundredthCharacterOfAToken) {
    const Boundary cases[] = {
        {std::string(99, 'a') + " ", {T::IDENTIFIER}},
        {std::string(99, 'a'), {T::IDENTIFIER}},
        {std::string(100, 'a'), {T::LEX_ERROR}},
        {std::string(100, 'a') + " ", {T::LEX_ERROR}},
        {"int " + std::string(99, 'b') + ";", {T::INT, T::IDENTIFIER, ';'}},
        {std::string(99, '7') + ";", {T::CONSTANT, ';'}},
        {std::string(100, '7'), {T::LEX_ERROR}},
        {"0x" + std::string(97, 'F') + " ", {T::CONSTANT}},
        {"0x" + std::string(98, 'F'), {T::LEX_ERROR}},
        {"1." + std::string(97, '5') + ";", {T::CONSTANT, ';'}},
        {"1." + std::string(98, '5') + ";", {T::LEX_ERROR}},
        // The read-ahead counts even where the token turns out shorter: after 97 digits the
        // automaton reads "e+" hoping for an exponent.
        {std::string(97, '1') + "e+x", {T::CONSTANT, T::IDENTIFIER, '+', T::IDENTIFIER}},
        {std::string(98, '1') + "e+x", {T::LEX_ERROR}},
        // A closed literal ends its token: the character after it is never read.
        {"\"" + std::string(98, 's') + "\"", {T::STRING_LITERAL}},
        {"\"" + std::string(99, 's') + "\"", {T::LEX_ERROR}},
        {"'" + std::string(98, 's') + "'", {T::CONSTANT}},
        {"L'" + std::string(98, 's') + "'", {T::LEX_ERROR}},
    };
    for (const Boundary& c : cases)
        EXPECT_EQ(codes(c.text), c.codes) << c.text.size() << ": " << c.text;
}

TEST_F(KsCItfScannerTest, UnterminatedQuoteIsSkippedWhileItsLiteralFitsTheBuffer) {
    const Boundary cases[] = {
        {"\"abc def", {T::IDENTIFIER, T::IDENTIFIER}},
        {"'abc", {T::IDENTIFIER}},
        {"L\"abc", {T::IDENTIFIER, T::IDENTIFIER}},
        {"\"" + std::string(98, ' '), {}},
        {"\"" + std::string(97, ' ') + "x", {T::IDENTIFIER}},
        {"\"" + std::string(99, ' '), {T::LEX_ERROR}},
        {"x \"" + std::string(120, ' ') + "\n", {T::IDENTIFIER, T::LEX_ERROR}},
        // A backslash takes any character but a newline, and nothing at the end of the text.
        {"\"a\\\nb\"", {T::IDENTIFIER, T::IDENTIFIER}},
        {"\"abc\\", {T::IDENTIFIER}},
        {"'\\", {}},
        {"''", {}},
        // Bytes of 128 or more end a literal's chance.
        {"\"\xe4\" x", {T::IDENTIFIER}},
    };
    for (const Boundary& c : cases)
        EXPECT_EQ(codes(c.text), c.codes) << c.text;

    std::vector<Token> tokens = scan("\"abc def");
    ASSERT_EQ(tokens.size(), 2u);
    EXPECT_EQ(tokens[0].value, "abc");
    EXPECT_EQ(tokens[0].column, 3);
}

TEST_F(KsCItfScannerTest, OverflowIsReportedOnceWhereTheRefusedTokenStarts) {
    KsCItfScanner& scanner = start("x\n  yy " + std::string(150, 'z') + " w");
    ASSERT_EQ(scanner.lex(), T::IDENTIFIER);
    ASSERT_EQ(scanner.lex(), T::IDENTIFIER);
    EXPECT_EQ(scanner.lex(), T::LEX_ERROR);
    EXPECT_EQ(texts(), (std::vector<std::string>{"ICode test frame error: Syntax error in file "
                                                 "unit, line 2, column 5: Token buffer overflow"}));
    EXPECT_FALSE(session->info().isSuccess());
    // The file is abandoned: the scanner has nothing more to give.
    EXPECT_EQ(scanner.lex(), T::END_OF_INPUT);
    EXPECT_EQ(scanner.lex(), T::END_OF_INPUT);
    EXPECT_EQ(messages().size(), 1u);
}

// --- Characters no token takes ----------------------------------------------------------------

TEST_F(KsCItfScannerTest, IgnoredCharactersVanishWithoutMovingTheColumn) {
    captureOutput();
    std::string ignored = "#$@`\\\x7f\r";
    for (char c = 1; c < 32; ++c)
        if (c != '\t' && c != '\n' && c != '\v' && c != '\f')
            ignored += c;
    std::vector<Token> tokens = scan(ignored + "a" + ignored + "b");
    ASSERT_EQ(tokens.size(), 2u);
    EXPECT_EQ(tokens[0].value, "a");
    EXPECT_EQ(tokens[0].column, 1);
    EXPECT_EQ(tokens[1].value, "b");
    EXPECT_EQ(tokens[1].column, 2);
    EXPECT_EQ(outputText(), "");
}

TEST_F(KsCItfScannerTest, HighBytesPassThroughToTheOutput) {
    captureOutput();
    std::vector<Token> tokens = scan("\xe4"
                                     "a\xff\xff"
                                     "b\x80 '\xe9'");
    ASSERT_EQ(tokens.size(), 2u);
    EXPECT_EQ(tokens[0].value, "a");
    EXPECT_EQ(tokens[0].column, 1);
    EXPECT_EQ(tokens[1].value, "b");
    EXPECT_EQ(tokens[1].column, 2);
    EXPECT_EQ(outputText(), "\xe4\xff\xff\x80\xe9");
}

TEST_F(KsCItfScannerTest, HighBytesWithoutAnOutputAreSkipped) {
    EXPECT_EQ(codes("\xfe"
                    "a\xff"),
              (std::vector<int>{T::IDENTIFIER}));
}

// --- Comments ----------------------------------------------------------------------------------

struct Comment {
    const char* text;
    std::vector<int> codes;
    const char* output;
};

TEST_F(KsCItfScannerTest, CommentBodiesGoToTheOutputWithoutStars) {
    const Comment cases[] = {
        {"a/* x*y **/b", {T::IDENTIFIER, T::IDENTIFIER}, " xy /"},
        {"/**/", {}, "/"},
        {"/*/ x */;", {';'}, "/ x /"},
        {"/* a */ /* b */", {}, " a / b /"},
        {"/* line\n\tend */x", {T::IDENTIFIER}, " line\n\tend /"},
        {"/* open", {}, " open"},
        {"/* open *", {}, " open "},
        {"/*", {}, ""},
        {"x/", {T::IDENTIFIER, '/'}, ""},
        {"/* \xe4 */", {}, " \xe4 /"},
    };
    for (const Comment& c : cases) {
        captureOutput();
        EXPECT_EQ(codes(c.text), c.codes) << c.text;
        EXPECT_EQ(outputText(), c.output) << c.text;
        KsCHostMessageServer::setScannerOutput(nullptr);
    }
}

TEST_F(KsCItfScannerTest, LongCommentsAreNotTokens) {
    std::string body(5000, 'c');
    std::vector<Token> tokens = scan("/*" + body + "\n*/ x");
    ASSERT_EQ(tokens.size(), 1u);
    EXPECT_EQ(tokens[0].line, 2);
    EXPECT_EQ(tokens[0].column, 4);
    EXPECT_TRUE(messages().empty());
}

// --- End of input ------------------------------------------------------------------------------

TEST_F(KsCItfScannerTest, NulEndsTheInputForGood) {
    KsCItfScanner& scanner = start(std::string("a\0b", 3));
    EXPECT_EQ(scanner.lex(), T::IDENTIFIER);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(scanner.lex(), T::END_OF_INPUT);
        EXPECT_STREQ(scanner.getTokenText(), "");
    }
    EXPECT_EQ(codes(std::string("\"a\0b\"", 5)), (std::vector<int>{T::IDENTIFIER}));
    EXPECT_EQ(codes(""), (std::vector<int>{}));
}

TEST_F(KsCItfScannerTest, NoInputIsTheEndOfInput) {
    KsCItfScanner scanner;
    EXPECT_EQ(scanner.lex(), T::END_OF_INPUT);
    EXPECT_STREQ(scanner.getTokenText(), "");
}

// --- Token text ----------------------------------------------------------------------------------

TEST_F(KsCItfScannerTest, TokenTextIsPooledOncePerToken) {
    KsCItfScanner& scanner = start("foo 1.5 foo");
    EXPECT_STREQ(scanner.getTokenText(), "");
    ASSERT_EQ(scanner.lex(), T::IDENTIFIER);
    const char* first = scanner.getTokenText();
    EXPECT_STREQ(first, "foo");
    EXPECT_EQ(scanner.getTokenText(), first);
    ASSERT_EQ(scanner.lex(), T::CONSTANT);
    EXPECT_STREQ(scanner.getTokenText(), "1.5");
    ASSERT_EQ(scanner.lex(), T::IDENTIFIER);
    EXPECT_EQ(scanner.getTokenText(), first); // the pool shares equal texts
    EXPECT_EQ(scanner.lex(), T::END_OF_INPUT);
    EXPECT_STREQ(scanner.getTokenText(), "");
}

// --- Without a parse info ----------------------------------------------------------------------

TEST_F(KsCItfScannerTest, WorksWithoutParseInfo) {
    theParseInfo = nullptr;
    KsCItfScanner& scanner = start("a \"s\" " + std::string(120, 'q'));
    EXPECT_EQ(scanner.lex(), T::IDENTIFIER);
    EXPECT_EQ(theTokenValue.string, nullptr);
    EXPECT_STREQ(scanner.getTokenText(), "");
    EXPECT_EQ(scanner.lex(), T::STRING_LITERAL);
    EXPECT_EQ(theTokenValue.string, nullptr);
    EXPECT_EQ(scanner.lex(), T::LEX_ERROR);
    scanner.error("Syntax error");
    EXPECT_TRUE(messages().empty());
    EXPECT_TRUE(session->info().isSuccess());
}

TEST_F(KsCItfScannerTest, ErrorWithoutReporterStillClearsSuccess) {
    session->info().setMessages(nullptr);
    session->info().setTypeNameRegistry(nullptr);
    KsCItfScanner& scanner = start("INT");
    EXPECT_EQ(scanner.lex(), T::IDENTIFIER);
    scanner.error("Syntax error");
    EXPECT_TRUE(messages().empty());
    EXPECT_FALSE(session->info().isSuccess());
}

// --- Large inputs ------------------------------------------------------------------------------

TEST_F(KsCItfScannerTest, MegabyteRunsOfOneCharacterClass) {
    constexpr std::size_t kSize = 1 << 20;
    struct Run {
        char c;
        std::size_t tokens; // up to the end or the LEX_ERROR
        int lastCode;
    };
    const Run runs[] = {
        {' ', 0, 0},
        {'\n', 0, 0},
        {'\t', 0, 0},
        {'#', 0, 0},
        {'\r', 0, 0},
        {'\'', 0, 0},
        {'\\', 0, 0},
        {'"', kSize / 2, T::STRING_LITERAL},
        {'+', kSize / 2, T::INC_OP},
        {';', kSize, ';'},
        {'a', 1, T::LEX_ERROR},
        {'9', 1, T::LEX_ERROR},
    };
    for (const Run& run : runs) {
        KsCItfScanner& scanner = start(std::string(kSize, run.c));
        std::size_t count = 0;
        int last = 0;
        for (int code; count <= kSize && (code = scanner.lex()) != T::END_OF_INPUT;) {
            ++count;
            last = code;
            if (code == T::LEX_ERROR)
                break;
        }
        EXPECT_EQ(count, run.tokens) << int(run.c);
        EXPECT_EQ(last, run.lastCode) << int(run.c);
    }

    KsCItfScanner& scanner = start(std::string(kSize, '\n') + "x");
    ASSERT_EQ(scanner.lex(), T::IDENTIFIER);
    EXPECT_EQ(scanner.getLine(), static_cast<int>(kSize) + 1);

    std::vector<Token> tokens = scan(std::string(kSize, '\t') + "x");
    ASSERT_EQ(tokens.size(), 1u);
    EXPECT_EQ(tokens[0].column, static_cast<int>(kSize) * 8 + 1);

    captureOutput();
    EXPECT_EQ(codes(std::string(kSize, '\xf0') + "/*" + std::string(kSize, '*')),
              (std::vector<int>{}));
    EXPECT_EQ(outputText().size(), kSize);
}

// Random text over the characters that start, continue or break tokens: every token the
// scanner cuts out must be found in the text in order, and must scan to itself when alone.
TEST_F(KsCItfScannerTest, RandomTextCutsIntoTokensThatStandAlone) {
    const std::string alphabet = "aLx_0189.eEuU+-'\"\\/*\n\t <>=:%|&#\r\xe4";
    std::mt19937 random(20240611);
    for (int round = 0; round < 400; ++round) {
        std::string text;
        std::size_t length = random() % 300;
        for (std::size_t i = 0; i < length; ++i)
            text += alphabet[random() % alphabet.size()];
        std::vector<Token> tokens = scan(text);
        std::size_t from = 0;
        for (const Token& t : tokens) {
            if (t.code == T::LEX_ERROR)
                break;
            std::size_t at = text.find(t.text, from);
            ASSERT_NE(at, std::string::npos) << text;
            from = at + t.text.size();
            std::vector<Token> alone = scan(t.text + " ");
            ASSERT_EQ(alone.size(), 1u) << t.text;
            EXPECT_EQ(alone[0].code, t.code) << t.text;
            EXPECT_EQ(alone[0].text, t.text);
            EXPECT_EQ(alone[0].value, t.value);
            EXPECT_EQ(alone[0].number, t.number) << t.text;
        }
    }
}

} // namespace
