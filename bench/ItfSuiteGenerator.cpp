#include "ItfSuiteGenerator.h"

#include <string_view>

namespace {

// One block of the language; "@" stands for a number that makes the block's names its own.
constexpr std::string_view kBlock = R"(/* block @: declarations with and without annotations */
SMB_INFO(VAR_CLASS = GlobalVar, MIN = -100, MAX = 100, SCALE = LSB_1) sint16 g_level@;
uint8 g_table@[4] = { 1, 2, 3, 4, };
SMB_INFO(LSB = "1, 2, 3, 4", OFFSET = "0, 0, 0, 0") sint32 g_matrix@[2][2];
SMB_INFO(VAR_CLASS = MacroVar) sint16 LIMIT@ = 100;
DEFINE_ITERATION_CONTEXT(NAME = ic@, SLICE = 0:15)

SMB_INFO(FCN_CLASS = StdFunction, SMB_KIND = SMB_FUNCTION)
sint16 compute@(SMB_INFO(MIN = 0, MAX = 10) sint16 value, uint8 *bytes, float32 gain)
{
    sint16 i;
    sint16 sum;
    uint8 window[4];
    sum = 0;
    for (i = 0; i < value; i++; LOOP_INFO(VAR = i); IC_INFO(NAME = ic@)) {
        sum = sum ADD(TYPE = sint16, SCALE = LSB_1, MIN = -10, MAX = 10) window[i];
    }
    while (sum > 100; LOOP_INFO(VAR = sum)) {
        sum -= (sint16) CAST(TYPE = sint16) (gain * 2.5e1f);
    }
    do { sum = sum >> 1; } while (sum != 0 && i < 0x1F);
    GENERIC_LOOP(IC_INFO(NAME = ic@)) {
        window[IC_INFO(NAME = ic@, OFFSET = 0)] = 0;
    }
    if (sum == 0 || value <= 3) {
        sum = value ? value * 2 : -value;
    } else {
        sum = NOT(OPLEVEL = CODE) sum;
    }
    switch (value) {
    case 1: {
        sum += g_table@[IDX_INFO(STRICTLY = TRUE) 2];
        break;
    }
    default: {
        sum = compute@(ARG_INFO(TYPE = sint16) sum, bytes, gain);
    }
    }
    g_level@ = sum % 7 + (g_matrix@[0][1] << 2) - ~value;
    sum MUL_ASSIGN(OPLEVEL = CODE) 3;
    *bytes = sizeof(sint16) + LIMIT@;
    return sum;
}
)";

std::string block(int number) {
    std::string text;
    std::string digits = std::to_string(number);
    text.reserve(kBlock.size() + 16 * digits.size());
    for (char c : kBlock) {
        if (c == '@')
            text += digits;
        else
            text += c;
    }
    return text;
}

int linesOf(std::string_view text) {
    int lines = 0;
    for (char c : text)
        lines += c == '\n';
    return lines;
}

} // namespace

std::vector<ItfGeneratedFile> generateSuite(int files, int linesPerFile) {
    std::vector<ItfGeneratedFile> suite;
    int number = 0;
    for (int f = 0; f < files; ++f) {
        ItfGeneratedFile file{"module" + std::to_string(f) + ".itf", {}};
        while (linesOf(file.text) < linesPerFile)
            file.text += block(number++);
        suite.push_back(std::move(file));
    }
    return suite;
}
