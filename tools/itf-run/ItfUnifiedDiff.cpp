#include "ItfUnifiedDiff.h"

#include <algorithm>
#include <unordered_map>

namespace {

// Lines with their '\n'; a last line without one stays distinct from the same line with it.
std::vector<std::string_view> splitLines(std::string_view text) {
    std::vector<std::string_view> lines;
    std::size_t start = 0;
    while (start < text.size()) {
        std::size_t end = text.find('\n', start);
        end = end == std::string_view::npos ? text.size() : end + 1;
        lines.push_back(text.substr(start, end - start));
        start = end;
    }
    return lines;
}

// Myers' linear-space algorithm: find a point on a shortest edit path that halves its cost,
// then solve the two halves. Expected files can be large, so neither an N*M table nor a
// trace of every round is kept. A work list instead of recursion keeps the stack flat.
class LineDiffer {
public:
    LineDiffer(std::vector<int> a, std::vector<int> b)
        : a_(std::move(a)), b_(std::move(b)), removed_(a_.size()), added_(b_.size()) {}

    void solve() {
        std::vector<Box> work{{0, long(a_.size()), 0, long(b_.size())}};
        while (!work.empty()) {
            Box box = work.back();
            work.pop_back();
            while (box.a0 < box.a1 && box.b0 < box.b1 && a_[box.a0] == b_[box.b0])
                ++box.a0, ++box.b0;
            while (box.a0 < box.a1 && box.b0 < box.b1 && a_[box.a1 - 1] == b_[box.b1 - 1])
                --box.a1, --box.b1;
            if (box.a0 == box.a1 || box.b0 == box.b1) {
                markAll(box);
                continue;
            }
            long x = 0, y = 0;
            middle(box, x, y);
            if ((x == box.a0 && y == box.b0) || (x == box.a1 && y == box.b1)) {
                markAll(box); // cannot happen for a shortest path; ends the loop regardless
                continue;
            }
            work.push_back({box.a0, x, box.b0, y});
            work.push_back({x, box.a1, y, box.b1});
        }
    }

    std::vector<ItfDiffEdit> edits() const {
        std::vector<ItfDiffEdit> out;
        std::size_t i = 0, j = 0;
        while (i < a_.size() || j < b_.size()) {
            if (i < a_.size() && removed_[i])
                out.push_back({ItfDiffEdit::Kind::Remove, i++, j});
            else if (j < b_.size() && added_[j])
                out.push_back({ItfDiffEdit::Kind::Add, i, j++});
            else
                out.push_back({ItfDiffEdit::Kind::Keep, i++, j++});
        }
        return out;
    }

private:
    struct Box {
        long a0, a1, b0, b1;
    };

    void markAll(const Box& box) {
        for (long i = box.a0; i < box.a1; ++i)
            removed_[i] = true;
        for (long j = box.b0; j < box.b1; ++j)
            added_[j] = true;
    }

    // A point (x, y) on a shortest path through `box`, where it has ceil(D/2) edits behind it.
    // Both ends of the box differ and neither side is empty, so D >= 2.
    void middle(const Box& box, long& x, long& y) {
        const long n = box.a1 - box.a0, m = box.b1 - box.b0, delta = n - m;
        const bool odd = (delta & 1) != 0;
        const long maxD = (n + m + 1) / 2, offset = maxD + 1;
        // forward_[k]: furthest x on diagonal k = x - y; backward_[c]: least x on diagonal
        // delta + c, walking back from the end. Points off the box are harmless: no path
        // through them returns to it.
        forward_.assign(std::size_t(2 * offset + 1), 0);
        backward_.assign(std::size_t(2 * offset + 1), 0);
        auto f = [&](long k) -> long& { return forward_[std::size_t(k + offset)]; };
        auto r = [&](long c) -> long& { return backward_[std::size_t(c + offset)]; };
        const int* a = a_.data() + box.a0;
        const int* b = b_.data() + box.b0;
        f(1) = 0;
        r(1) = n + 1;
        for (long d = 0; d <= maxD; ++d) {
            for (long k = -d; k <= d; k += 2) {
                long px = (k == -d || (k != d && f(k - 1) < f(k + 1))) ? f(k + 1) : f(k - 1) + 1;
                long py = px - k;
                while (px < n && py < m && a[px] == b[py])
                    ++px, ++py;
                f(k) = px;
                long c = k - delta;
                if (odd && c >= -(d - 1) && c <= d - 1 && px >= r(c)) {
                    x = box.a0 + px, y = box.b0 + py;
                    return;
                }
            }
            for (long c = -d; c <= d; c += 2) {
                long px =
                    (c == -d || (c != d && r(c + 1) - 1 < r(c - 1))) ? r(c + 1) - 1 : r(c - 1);
                long k = c + delta;
                long py = px - k;
                while (px > 0 && py > 0 && a[px - 1] == b[py - 1])
                    --px, --py;
                r(c) = px;
                if (!odd && k >= -d && k <= d && px <= f(k)) {
                    x = box.a0 + px, y = box.b0 + py;
                    return;
                }
            }
        }
        x = box.a0, y = box.b0; // unreachable: the paths meet by round maxD
    }

    std::vector<int> a_, b_;
    std::vector<bool> removed_, added_;
    std::vector<long> forward_, backward_;
};

// A line as a hunk shows it: the marker, the text, and the note on a missing newline.
void appendLine(std::string& out, char marker, std::string_view line) {
    out += marker;
    out += line;
    if (line.empty() || line.back() != '\n')
        out += "\n\\ No newline at end of file\n";
}

// "start,count" of one side of a hunk header; an empty side names the line before it.
std::string range(std::size_t first, std::size_t count) {
    std::string text = std::to_string(count == 0 ? first : first + 1);
    if (count != 1)
        text += "," + std::to_string(count);
    return text;
}

} // namespace

std::vector<ItfDiffEdit> itfLineDiff(std::string_view oldText, std::string_view newText) {
    std::vector<std::string_view> oldLines = splitLines(oldText), newLines = splitLines(newText);
    // Compare numbers, not strings: equal lines share one id.
    std::unordered_map<std::string_view, int> ids;
    auto number = [&](const std::vector<std::string_view>& lines) {
        std::vector<int> out;
        out.reserve(lines.size());
        for (std::string_view line : lines)
            out.push_back(ids.emplace(line, int(ids.size())).first->second);
        return out;
    };
    std::vector<int> a = number(oldLines);
    std::vector<int> b = number(newLines);
    LineDiffer differ(std::move(a), std::move(b));
    differ.solve();
    return differ.edits();
}

std::string itfUnifiedDiff(std::string_view oldText, std::string_view newText,
                           const std::string& oldLabel, const std::string& newLabel,
                           std::size_t context) {
    if (oldText == newText)
        return {};
    std::vector<std::string_view> oldLines = splitLines(oldText), newLines = splitLines(newText);
    std::vector<ItfDiffEdit> edits = itfLineDiff(oldText, newText);
    std::string out = "--- " + oldLabel + "\n+++ " + newLabel + "\n";

    auto isChange = [&](std::size_t i) { return edits[i].kind != ItfDiffEdit::Kind::Keep; };
    std::size_t i = 0;
    while (i < edits.size()) {
        if (!isChange(i)) {
            ++i;
            continue;
        }
        // Changes closer than two contexts apart share a hunk.
        std::size_t last = i;
        for (std::size_t j = i + 1; j < edits.size() && j <= last + 2 * context + 1; ++j)
            if (isChange(j))
                last = j;
        std::size_t begin = i > context ? i - context : 0;
        std::size_t end = std::min(edits.size(), last + 1 + context);

        std::size_t oldCount = 0, newCount = 0;
        for (std::size_t j = begin; j < end; ++j) {
            oldCount += edits[j].kind != ItfDiffEdit::Kind::Add;
            newCount += edits[j].kind != ItfDiffEdit::Kind::Remove;
        }
        out += "@@ -" + range(edits[begin].oldLine, oldCount) + " +" +
               range(edits[begin].newLine, newCount) + " @@\n";
        for (std::size_t j = begin; j < end; ++j) {
            const ItfDiffEdit& e = edits[j];
            if (e.kind == ItfDiffEdit::Kind::Keep)
                appendLine(out, ' ', oldLines[e.oldLine]);
            else if (e.kind == ItfDiffEdit::Kind::Remove)
                appendLine(out, '-', oldLines[e.oldLine]);
            else
                appendLine(out, '+', newLines[e.newLine]);
        }
        i = end;
    }
    return out;
}
