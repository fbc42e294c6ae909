// Token codes shared by the scanner and the parser.
#pragma once

class KsCItfString;

namespace KsEItfToken {
enum : int {
    END_OF_INPUT = 0,
    // The scanner hands this to the parser after it has reported an error of its own: the
    // parse is abandoned without a second message.
    LEX_ERROR = 256,
#define ITF_TOKEN(Name, Code, Spelling) Name = Code,
#include "ItfScanner/KsCItfTokens.def"
#undef ITF_TOKEN
};
} // namespace KsEItfToken

// The value of the last token: the double of a CONSTANT, the string node of an IDENTIFIER,
// TYPE_NAME or STRING_LITERAL.
union KsUItfTokenValue {
    double number;
    KsCItfString* string;
};

// Module-wide, as the parser reads them after each token.
extern KsUItfTokenValue theTokenValue;
extern int theColumn;
