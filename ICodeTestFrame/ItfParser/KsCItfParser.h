// The parser: reads the tokens of one test file from the scanner and builds the file's syntax
// tree through the node factory of the parse info. A table-driven LALR(1) automaton generated
// from KsCItfGrammar.y, with explicit stacks of a fixed depth; the first syntax error abandons
// the file with one message.
#pragma once

#include "ItfBase/KsCItfMemory.h"

#include <cstddef>

class KsCItfScanner;

class KsCItfParser : public KsCItfObject {
public:
    // The smallest depth a parse can work with.
    static constexpr int kMinDepth = 20;

    // `depth`: the most states the stack may hold; deeper nesting is a "Parser stack overflow".
    explicit KsCItfParser(int depth);
    // Also returns stacks that a parse abandoned by an exception left behind.
    virtual ~KsCItfParser();

    // 0 when the input was accepted, 1 when the parse was abandoned. The translation unit is
    // reached through the parse info's root.
    int parse(KsCItfScanner* scanner);

    int getDepth() const { return depth_; }

    // The generated parser's stacks grow through these, so that the parser object owns them.
    void* allocateStack(std::size_t size);
    void releaseStack(void* block);

private:
    int depth_;
    // While the stacks grow, the old and the new block exist at the same time.
    void* stackBlocks_[2] = {nullptr, nullptr};
};
