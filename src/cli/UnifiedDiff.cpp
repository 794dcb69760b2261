// SPDX-License-Identifier: MIT
#include "UnifiedDiff.h"

#include <algorithm>
#include <vector>

namespace {

using Lines = std::vector<std::string_view>;

Lines linesOf(std::string_view text)
{
    Lines lines;
    for (std::size_t start = 0; start < text.size();) {
        const auto end = std::min(text.find('\n', start), text.size() - 1) + 1;
        lines.push_back(text.substr(start, end - start));
        start = end;
    }
    return lines;
}

enum class Op { Keep, Remove, Add };

// Myers' search for the shortest edit script: row d holds, for each diagonal k = x - y from -d to
// d, the furthest x that d added or removed lines reach.
class Trace {
public:
    long at(long d, long k) const { return rows_[static_cast<std::size_t>(d)][static_cast<std::size_t>(k + d)]; }
    long steps() const { return static_cast<long>(rows_.size()) - 1; }
    // Step d on diagonal k came down from k + 1 (a line added) rather than across from k - 1 (removed).
    bool cameDown(long d, long k) const { return k == -d || (k != d && at(d - 1, k - 1) < at(d - 1, k + 1)); }

    // False when the ends lie more than maxSteps apart.
    template <typename Same>
    bool search(long n, long m, long maxSteps, Same same)
    {
        for (long d = 0; d <= std::min(n + m, maxSteps); ++d) {
            rows_.emplace_back(static_cast<std::size_t>(2 * d + 1));
            bool reached = false;
            for (long k = -d; k <= d; k += 2) {
                long x = d == 0 ? 0 : cameDown(d, k) ? at(d - 1, k + 1) : at(d - 1, k - 1) + 1;
                while (x < n && x - k < m && same(x, x - k))
                    ++x;
                rows_.back()[static_cast<std::size_t>(k + d)] = x;
                reached = reached || (x >= n && x - k >= m);
            }
            if (reached)
                return true;
        }
        return false;
    }

    // The path from the end back to the start, as operations in their forward order.
    std::vector<Op> path(long x, long y) const
    {
        std::vector<Op> backwards;
        for (long d = steps(); d > 0; --d) {
            const long k = x - y;
            const bool down = cameDown(d, k);
            const long startX = down ? at(d - 1, k + 1) : at(d - 1, k - 1) + 1;
            for (; x > startX; --x, --y)
                backwards.push_back(Op::Keep);
            backwards.push_back(down ? Op::Add : Op::Remove);
            x -= down ? 0 : 1;
            y -= down ? 1 : 0;
        }
        backwards.insert(backwards.end(), static_cast<std::size_t>(x), Op::Keep);
        return {backwards.rbegin(), backwards.rend()};
    }

private:
    std::vector<std::vector<long>> rows_;
};

// The shortest edit script between a and b, the kept lines at both ends taken off first. Lines
// too far apart for a short search are all replaced.
std::vector<Op> editScript(const Lines& a, const Lines& b)
{
    std::size_t head = 0, tail = 0;
    while (head < a.size() && head < b.size() && a[head] == b[head])
        ++head;
    while (tail < a.size() - head && tail < b.size() - head && a[a.size() - 1 - tail] == b[b.size() - 1 - tail])
        ++tail;
    const auto n = static_cast<long>(a.size() - head - tail), m = static_cast<long>(b.size() - head - tail);
    const auto same = [&](long x, long y) {
        return a[head + static_cast<std::size_t>(x)] == b[head + static_cast<std::size_t>(y)];
    };
    std::vector<Op> script(head, Op::Keep);
    Trace trace;
    if (trace.search(n, m, 1000, same)) {
        const auto middle = trace.path(n, m);
        script.insert(script.end(), middle.begin(), middle.end());
    } else {
        script.insert(script.end(), static_cast<std::size_t>(n), Op::Remove);
        script.insert(script.end(), static_cast<std::size_t>(m), Op::Add);
    }
    script.insert(script.end(), tail, Op::Keep);
    return script;
}

std::string range(std::size_t start, std::size_t count)
{
    // An empty range names the line before it; a range of one line has no count.
    auto text = std::to_string(count == 0 ? start : start + 1);
    if (count != 1) {
        text += ',';
        text += std::to_string(count);
    }
    return text;
}

void addLine(std::string& out, char sign, std::string_view line)
{
    out += sign;
    out += line;
    if (!line.ends_with('\n'))
        out += "\n\\ No newline at end of file\n";
}

} // namespace

std::string UnifiedDiff(std::string_view before, std::string_view after, const std::string& from, const std::string& to)
{
    const auto a = linesOf(before), b = linesOf(after);
    const auto script = editScript(a, b);
    constexpr std::size_t Context = 3;
    std::string out;
    std::size_t i = 0, x = 0, y = 0; // position in the script, in a, in b
    while (i < script.size()) {
        const auto change =
            std::find_if(script.begin() + static_cast<long>(i), script.end(), [](Op op) { return op != Op::Keep; });
        if (change == script.end())
            break;
        // Start the hunk up to three kept lines before the change.
        const auto skip = static_cast<std::size_t>(change - script.begin()) - i;
        const auto lead = std::min(skip, Context);
        i += skip - lead;
        x += skip - lead;
        y += skip - lead;
        // End it where more than six kept lines follow a change, or at the end.
        std::size_t end = i, keptRun = 0, lastChange = i;
        for (; end < script.size() && keptRun <= 2 * Context; ++end) {
            keptRun = script[end] == Op::Keep ? keptRun + 1 : 0;
            lastChange = script[end] == Op::Keep ? lastChange : end;
        }
        end = std::min(script.size(), lastChange + 1 + Context);
        std::string body;
        std::size_t fromA = 0, fromB = 0;
        const auto startX = x, startY = y;
        for (; i < end; ++i) {
            const auto op = script[i];
            addLine(body, op == Op::Keep ? ' ' : op == Op::Remove ? '-' : '+', op == Op::Add ? b[y] : a[x]);
            if (op != Op::Add)
                ++x, ++fromA;
            if (op != Op::Remove)
                ++y, ++fromB;
        }
        out += "@@ -" + range(startX, fromA) + " +" + range(startY, fromB) + " @@\n" + body;
    }
    return out.empty() ? out : "--- " + from + "\n+++ " + to + "\n" + out;
}
