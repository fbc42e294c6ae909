// A line diff of two texts in the unified format that `diff -u` and review tools show, so that
// a failing check reads like any other failing golden-file test.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// One step of turning the old text into the new one.
struct ItfDiffEdit {
    enum class Kind { Keep, Remove, Add };
    Kind kind;
    std::size_t oldLine; // 0-based index of the old line kept or removed, or of the next one
    std::size_t newLine; // the same for the new text
};

// A shortest edit script from `oldText` to `newText`, compared line by line (a line keeps its
// '\n', so a missing newline at the end is a difference). Removals come before additions
// within a change.
std::vector<ItfDiffEdit> itfLineDiff(std::string_view oldText, std::string_view newText);

// The unified diff ("--- oldLabel", "+++ newLabel", hunks with `context` lines around each
// change); empty when the texts are equal.
std::string itfUnifiedDiff(std::string_view oldText, std::string_view newText,
                           const std::string& oldLabel, const std::string& newLabel,
                           std::size_t context = 3);
