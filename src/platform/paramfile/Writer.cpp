#include "paramfile/ParamFileImpl.h"

#include <algorithm>
#include <charconv>
#include <cstring>

namespace paramfile {
namespace {

constexpr std::size_t kNumberRoom = 34; // a real, an int64 or a boolean, with ", "

// Writes through a raw pointer into a string sized ahead, so the hot path has no checks
// beyond one room test per line.
class Out {
public:
    Out(std::string& s, std::size_t hint) : s_(s) {
        if (s_.size() < hint)
            s_.resize(hint);
        p_ = s_.data();
        end_ = p_ + s_.size();
    }
    char* Room(std::size_t n) {
        if (static_cast<std::size_t>(end_ - p_) < n)
            Grow(n);
        return p_;
    }
    void Commit(char* p) { p_ = p; }
    void Finish() { s_.resize(static_cast<std::size_t>(p_ - s_.data())); }

private:
    void Grow(std::size_t n) {
        const auto used = static_cast<std::size_t>(p_ - s_.data());
        s_.resize(std::max(s_.size() * 2, used + n + 4096));
        p_ = s_.data() + used;
        end_ = s_.data() + s_.size();
    }
    std::string& s_;
    char* p_;
    char* end_;
};

const char* Spaces() {
    static const std::string spaces(4 * (kMaxDepth + 1), ' ');
    return spaces.data();
}

inline char* Put(char* o, std::string_view s) {
    std::memcpy(o, s.data(), s.size());
    return o + s.size();
}

inline char* Indent(char* o, std::size_t depth) {
    const std::size_t n = 4 * std::min<std::size_t>(depth, kMaxDepth + 1);
    std::memcpy(o, Spaces(), n);
    return o + n;
}

char* PutString(char* o, std::string_view s) {
    *o++ = '"';
    for (const char c : s) {
        switch (c) {
        case '"':
            *o++ = '\\';
            *o++ = '"';
            break;
        case '\\':
            *o++ = '\\';
            *o++ = '\\';
            break;
        case '\n':
            *o++ = '\\';
            *o++ = 'n';
            break;
        case '\t':
            *o++ = '\\';
            *o++ = 't';
            break;
        case '\r':
            *o++ = '\\';
            *o++ = 'r';
            break;
        default:
            *o++ = c;
        }
    }
    *o++ = '"';
    return o;
}

char* PutFileName(char* o, std::string_view s) {
    // A file name cannot hold a line break; such a value survives only as a string.
    if (s.find('\n') != std::string_view::npos)
        return PutString(o, s);
    *o++ = '\'';
    for (const char c : s) {
        *o++ = c;
        if (c == '\'')
            *o++ = '\'';
    }
    *o++ = '\'';
    return o;
}

char* PutParam(char* o, const Param& p) {
    switch (p.Type()) {
    case ParamType::Integer:
        return std::to_chars(o, o + 24, Access::IntOf(p)).ptr;
    case ParamType::Double:
        return FormatDouble(o, Access::DoubleOf(p));
    case ParamType::Float:
        return FormatFloat(o, Access::FloatOf(p));
    case ParamType::Boolean:
        return Access::IntOf(p) ? Put(o, "true") : Put(o, "false");
    case ParamType::String:
        return PutString(o, Access::TextOf(p));
    case ParamType::FileName:
        return PutFileName(o, Access::TextOf(p));
    }
    return o;
}

void PutLines(Out& w, std::string_view lines, std::size_t depth) {
    while (!lines.empty()) {
        const std::size_t nl = lines.find('\n');
        const std::string_view line = lines.substr(0, nl);
        char* o = w.Room(4 * (depth + 1) + line.size() + 1);
        o = Indent(o, depth);
        o = Put(o, line);
        *o++ = '\n';
        w.Commit(o);
        if (nl == std::string_view::npos)
            break;
        lines.remove_prefix(nl + 1);
    }
}

} // namespace

void WriteText(const Document& doc, std::string& out) {
    const Document::Impl& d = doc.impl();
    std::size_t hint = d.sourceBytes + d.sourceBytes / 8;
    if (hint == 0)
        hint = d.keywords.size() * 48 + d.params.size() * 20 + d.sections.size() * 32 +
               d.text.Bytes() + 256;
    Out w(out, hint);

    struct Frame {
        const Section* section;
        std::uint32_t next;
    };
    std::vector<Frame> stack;
    stack.push_back({&d.sections[0], 0});
    const std::uint32_t* entries = d.entries.data();
    const Keyword* keywords = d.keywords.data();
    const Param* params = d.params.data();
    const bool hasComments = !d.comments.empty() || !d.closingComments.empty();
    const Document::Impl::Comments* comments = nullptr;
    auto commentsOf = [&](std::uint32_t key) -> const Document::Impl::Comments* {
        if (!hasComments)
            return nullptr;
        const auto it = d.comments.find(key);
        return it == d.comments.end() ? nullptr : &it->second;
    };

    while (!stack.empty()) {
        Frame& f = stack.back();
        const std::size_t depth = stack.size() - 1;
        if (f.next == Access::EntryCount(*f.section)) {
            if (hasComments) {
                const auto it = d.closingComments.find(
                    static_cast<std::uint32_t>(f.section - d.sections.data()));
                if (it != d.closingComments.end())
                    PutLines(w, it->second, depth);
            }
            stack.pop_back();
            if (depth > 0) {
                char* o = w.Room(4 * depth + 2);
                o = Indent(o, depth - 1);
                *o++ = '}';
                *o++ = '\n';
                w.Commit(o);
            }
            continue;
        }
        const std::uint32_t e = entries[Access::FirstEntry(*f.section) + f.next++];
        comments = commentsOf(e);
        if (comments)
            PutLines(w, comments->before, depth);
        const std::string_view after = comments ? std::string_view(comments->after) : "";
        if (e & kSectionBit) {
            const Section& s = d.sections[e & ~kSectionBit];
            const std::string_view name = d.names[Access::NameId(s)];
            char* o = w.Room(4 * depth + name.size() + after.size() + 4);
            o = Indent(o, depth);
            o = Put(o, name);
            o = Put(o, " {");
            if (!after.empty()) {
                *o++ = ' ';
                o = Put(o, after);
            }
            *o++ = '\n';
            w.Commit(o);
            stack.push_back({&s, 0});
            continue;
        }
        const Keyword& k = keywords[e];
        const std::string_view name = d.names[Access::NameId(k)];
        const Param* ps = params + Access::FirstParam(k);
        const std::uint32_t n = static_cast<std::uint32_t>(k.ParamCount());
        std::size_t room = 4 * depth + name.size() + 5 + after.size() + n * kNumberRoom;
        for (std::uint32_t i = 0; i < n; ++i)
            if (ps[i].Type() == ParamType::String || ps[i].Type() == ParamType::FileName)
                room += 2 * Access::TextOf(ps[i]).size() + 4;
        char* o = w.Room(room);
        o = Indent(o, depth);
        o = Put(o, name);
        *o++ = ' ';
        *o++ = '=';
        for (std::uint32_t i = 0; i < n; ++i) {
            if (i > 0)
                *o++ = ',';
            *o++ = ' ';
            o = PutParam(o, ps[i]);
        }
        if (!after.empty()) {
            *o++ = ' ';
            o = Put(o, after);
        }
        *o++ = '\n';
        w.Commit(o);
    }
    w.Finish();
}

std::string WriteText(const Document& doc) {
    std::string out;
    WriteText(doc, out);
    return out;
}

} // namespace paramfile
