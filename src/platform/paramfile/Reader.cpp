#include "paramfile/ParamFileImpl.h"

#include <array>
#include <charconv>
#include <climits>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <limits>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

namespace paramfile {
namespace {

enum : std::uint8_t {
    kStart = 1, // first character of a name
    kName = 2,  // later characters of a name
    kDigit = 4,
    kBlank = 8,     // space, tab, CR
    kEnd = 16,      // ends a value: blank, newline, comma, '#', NUL
    kStrStop = 32,  // needs attention inside "...": quote, backslash, newline, NUL
    kFileStop = 64, // needs attention inside '...': quote, newline, NUL
};

constexpr std::array<std::uint8_t, 256> MakeClasses() {
    std::array<std::uint8_t, 256> t{};
    for (int c = 'a'; c <= 'z'; ++c)
        t[c] |= kStart | kName;
    for (int c = 'A'; c <= 'Z'; ++c)
        t[c] |= kStart | kName;
    t['_'] |= kStart | kName;
    for (int c = '0'; c <= '9'; ++c)
        t[c] |= kName | kDigit;
    for (int c : {' ', '\t', '\r'})
        t[c] |= kBlank | kEnd;
    for (int c : {'\n', ',', '#', '\0'})
        t[c] |= kEnd;
    for (int c : {'"', '\\', '\n', '\0'})
        t[c] |= kStrStop;
    for (int c : {'\'', '\n', '\0'})
        t[c] |= kFileStop;
    return t;
}

constexpr std::array<std::uint8_t, 256> kClass = MakeClasses();

inline std::uint8_t Cls(char c) {
    return kClass[static_cast<unsigned char>(c)];
}

constexpr double kPow10[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,  1e8,  1e9,  1e10, 1e11,
                             1e12, 1e13, 1e14, 1e15, 1e16, 1e17, 1e18, 1e19, 1e20, 1e21, 1e22};

struct Counts {
    std::size_t equals = 0, commas = 0, braces = 0;
};

// Sizes the tables up front: growing them by doubling costs copies and leaves slack.
Counts CountMarks(const char* p, std::size_t n) {
    Counts c;
    std::size_t i = 0;
#if defined(__SSE2__)
    const __m128i eq = _mm_set1_epi8('='), comma = _mm_set1_epi8(','), brace = _mm_set1_epi8('{'),
                  zero = _mm_setzero_si128();
    while (i + 16 <= n) {
        __m128i ae = zero, ac = zero, ab = zero;
        // Byte counters overflow after 255 rounds.
        for (int round = 0; round < 255 && i + 16 <= n; ++round, i += 16) {
            const __m128i v = _mm_loadu_si128(reinterpret_cast<const __m128i*>(p + i));
            ae = _mm_sub_epi8(ae, _mm_cmpeq_epi8(v, eq));
            ac = _mm_sub_epi8(ac, _mm_cmpeq_epi8(v, comma));
            ab = _mm_sub_epi8(ab, _mm_cmpeq_epi8(v, brace));
        }
        auto sum = [&](__m128i a) {
            const __m128i s = _mm_sad_epu8(a, zero);
            return static_cast<std::size_t>(_mm_cvtsi128_si32(s)) +
                   static_cast<std::size_t>(_mm_extract_epi16(s, 4));
        };
        c.equals += sum(ae);
        c.commas += sum(ac);
        c.braces += sum(ab);
    }
#endif
    for (; i < n; ++i) {
        c.equals += p[i] == '=';
        c.commas += p[i] == ',';
        c.braces += p[i] == '{';
    }
    return c;
}

// End of the name starting at p; sixteen bytes a step where the text allows.
const char* NameEnd(const char* p, const char* end) {
#if defined(__SSE2__)
    const __m128i under = _mm_set1_epi8('_'), lower = _mm_set1_epi8(0x20);
    const __m128i a1 = _mm_set1_epi8('a' - 1), z1 = _mm_set1_epi8('z' + 1);
    const __m128i d1 = _mm_set1_epi8('0' - 1), d9 = _mm_set1_epi8('9' + 1);
    while (end - p >= 16) {
        const __m128i v = _mm_loadu_si128(reinterpret_cast<const __m128i*>(p));
        const __m128i folded = _mm_or_si128(v, lower);
        const __m128i letter =
            _mm_and_si128(_mm_cmpgt_epi8(folded, a1), _mm_cmplt_epi8(folded, z1));
        const __m128i digit = _mm_and_si128(_mm_cmpgt_epi8(v, d1), _mm_cmplt_epi8(v, d9));
        const __m128i ok = _mm_or_si128(_mm_or_si128(letter, digit), _mm_cmpeq_epi8(v, under));
        const unsigned stop = ~static_cast<unsigned>(_mm_movemask_epi8(ok)) & 0xFFFFu;
        if (stop != 0)
            return p + __builtin_ctz(stop);
        p += 16;
    }
#endif
    (void)end;
    while (Cls(*p) & kName)
        ++p;
    return p;
}

template <class Vector> void Trim(Vector& v) {
    if (v.capacity() > v.size() + v.size() / 8 + 256)
        v.shrink_to_fit();
}

class Reader {
public:
    Reader(const std::string& text, Document& doc)
        : doc_(doc), d_(doc.impl()), p_(text.data()), end_(text.data() + text.size()),
          lineStart_(text.data()) {}

    bool Run();
    Diagnostic error;
    // The document's root is its first section.
    bool OpenedASection() const { return d_.sections.size() > 1; }

private:
    Position PosOf(const char* at) const { return {line_, static_cast<int>(at - lineStart_) + 1}; }
    bool Fail(const char* at, std::string message) {
        error = Diagnostic{d_.fileName, PosOf(at), std::move(message)};
        return false;
    }
    bool FailEof(std::string message) {
        error = Diagnostic{d_.fileName, PosOf(end_), std::move(message)};
        return false;
    }
    void SkipBlanks() {
        const char* q = p_;
        while (Cls(*q) & kBlank)
            ++q;
        p_ = q;
    }
    bool LineEnds(const char* q) const {
        return *q == '\n' || *q == '#' || (*q == '\0' && q == end_);
    }
    std::uint32_t Intern(const char* b, const char* e) {
        const auto n = static_cast<std::size_t>(e - b);
        return d_.names.Intern({b, n}, HashName(b, n), d_.text);
    }
    std::string Token(const char* at) const;

    bool OpenSection(const char* name, const char* nameEnd);
    void CloseSection();
    bool ReadKeyword(const char* name, const char* nameEnd);
    bool ReadValue();
    bool ReadString();
    bool ReadFileName();
    bool ReadNumber();
    bool ReadWord();
    void Push(const Param& p) {
        d_.params.push_back(p);
        ++Access::ParamCount(d_.keywords.back());
    }
    void ReadComment();
    // The entry just made takes the comment lines before it.
    void Attach(std::uint32_t key) {
        if (!pendingComment_.empty()) {
            d_.comments[key].before = std::move(pendingComment_);
            pendingComment_.clear();
        }
        lastEntry_ = key;
        lastEntryLine_ = line_;
    }
    void CheckUtf8(const char* begin, const char* end, const char* what);

    struct Open {
        std::uint32_t section;
        std::uint32_t pendingStart;
    };

    Document& doc_;
    Document::Impl& d_;
    const char* p_;
    const char* end_;
    const char* lineStart_;
    int line_ = 1;
    std::vector<Open> open_;
    // Entries of the open sections, innermost last; a section's run moves to the
    // document when it closes, so every section's entries end up contiguous.
    std::vector<std::uint32_t> pending_;
    std::string scratch_;
    std::string pendingComment_;
    std::int64_t lastEntry_ = -1; // entry key of the last keyword or section opened
    int lastEntryLine_ = 0;
};

void Reader::ReadComment() {
    const void* nl = std::memchr(p_, '\n', static_cast<std::size_t>(end_ - p_));
    const char* e = nl ? static_cast<const char*>(nl) : end_;
    const char* t = e;
    while (t > p_ && (t[-1] == ' ' || t[-1] == '\t' || t[-1] == '\r'))
        --t;
    const std::string_view text(p_, std::size_t(t - p_));
    if (lastEntry_ >= 0 && lastEntryLine_ == line_) {
        d_.comments[static_cast<std::uint32_t>(lastEntry_)].after.assign(text);
    } else {
        if (!pendingComment_.empty())
            pendingComment_ += '\n';
        pendingComment_.append(text);
    }
    p_ = e;
}

// Length of the valid UTF-8 sequence at p (before end), 0 when it is not one.
std::size_t Utf8Length(const unsigned char* p, const unsigned char* end) {
    const unsigned c = p[0];
    std::size_t n;
    unsigned min;
    if (c < 0x80)
        return 1;
    if (c >= 0xC2 && c <= 0xDF) {
        n = 2;
        min = 0x80;
    } else if (c >= 0xE0 && c <= 0xEF) {
        n = 3;
        min = 0x800;
    } else if (c >= 0xF0 && c <= 0xF4) {
        n = 4;
        min = 0x10000;
    } else {
        return 0;
    }
    if (static_cast<std::size_t>(end - p) < n)
        return 0;
    unsigned cp = c & (0x7Fu >> n);
    for (std::size_t i = 1; i < n; ++i) {
        if ((p[i] & 0xC0) != 0x80)
            return 0;
        cp = cp << 6 | (p[i] & 0x3Fu);
    }
    if (cp < min || cp > 0x10FFFF || (cp >= 0xD800 && cp <= 0xDFFF))
        return 0;
    return n;
}

void Reader::CheckUtf8(const char* begin, const char* end, const char* what) {
    const auto* p = reinterpret_cast<const unsigned char*>(begin);
    const auto* e = reinterpret_cast<const unsigned char*>(end);
    while (p < e && *p < 0x80)
        ++p;
    while (p < e) {
        const std::size_t n = Utf8Length(p, e);
        if (n == 0) {
            char byte[8];
            std::snprintf(byte, sizeof byte, "0x%02X", *p);
            doc_.AddWarning(PosOf(reinterpret_cast<const char*>(p)),
                            Cat(what, " of '", d_.names[Access::NameId(d_.keywords.back())],
                                "' is not valid UTF-8 (byte ", byte, "); kept byte for byte"));
            return;
        }
        p += n;
    }
}

std::string Reader::Token(const char* at) const {
    const char* e = at;
    while (!(Cls(*e) & kEnd) && e - at < 40)
        ++e;
    return std::string(at, e);
}

std::string DescribeChar(char c) {
    const auto u = static_cast<unsigned char>(c);
    if (u > 32 && u < 127)
        return Cat("unexpected '", c, "'");
    char buf[32];
    std::snprintf(buf, sizeof buf, "unexpected byte 0x%02X", u);
    return buf;
}

bool Reader::Run() {
    if (end_ - p_ >= 3 && std::memcmp(p_, "\xEF\xBB\xBF", 3) == 0)
        lineStart_ = p_ += 3; // byte-order mark some editors add
    const Counts counts = CountMarks(p_, static_cast<std::size_t>(end_ - p_));
    d_.keywords.reserve(counts.equals);
    d_.params.reserve(counts.equals + counts.commas);
    d_.sections.reserve(counts.braces + 1);
    d_.entries.reserve(counts.equals + counts.braces);
    open_.push_back({0, 0});

    for (;;) {
        const char c = *p_;
        if (c == ' ') {
            // Indentation comes in runs of four.
            while (end_ - p_ >= 8 && std::memcmp(p_, "        ", 8) == 0)
                p_ += 8;
            while (*p_ == ' ')
                ++p_;
            continue;
        }
        if (Cls(c) & kBlank) {
            ++p_;
            continue;
        }
        if (c == '\n') {
            ++line_;
            lineStart_ = ++p_;
            continue;
        }
        if (c == '#') {
            ReadComment();
            continue;
        }
        if (c == '\0' && p_ == end_)
            break;
        if (c == '}') {
            if (open_.size() == 1)
                return Fail(p_, "unexpected '}'");
            CloseSection();
            lastEntry_ = -1;
            ++p_;
            continue;
        }
        if (!(Cls(c) & kStart))
            return Fail(p_, DescribeChar(c));
        const char* name = p_;
        const char* nameEnd = NameEnd(p_, end_);
        p_ = nameEnd;
        SkipBlanks();
        if (*p_ == '{') {
            if (!OpenSection(name, nameEnd))
                return false;
            ++p_;
        } else if (open_.size() == 1) {
            if (*p_ == '=')
                return Fail(name,
                            Cat("keyword '", std::string_view(name, std::size_t(nameEnd - name)),
                                "' outside a section"));
            return Fail(p_, Cat("expected '{' after section name '",
                                std::string_view(name, std::size_t(nameEnd - name)), "'"));
        } else if (*p_ == '=') {
            ++p_;
            if (!ReadKeyword(name, nameEnd))
                return false;
        } else {
            return Fail(p_, Cat("expected '=' after keyword '",
                                std::string_view(name, std::size_t(nameEnd - name)), "'"));
        }
    }
    if (open_.size() > 1) {
        const Section& s = d_.sections[open_.back().section];
        return FailEof(Cat("missing '}' for section '", s.Name(), "' opened at line ",
                           std::to_string(s.Pos().line)));
    }
    d_.end = PosOf(end_);
    CloseSection();
    Trim(d_.keywords);
    Trim(d_.params);
    Trim(d_.sections);
    Trim(d_.entries);
    return true;
}

bool Reader::OpenSection(const char* name, const char* nameEnd) {
    if (open_.size() > kMaxDepth)
        return Fail(name,
                    Cat("sections nested deeper than ", std::to_string(kMaxDepth), " levels"));
    const auto index = static_cast<std::uint32_t>(d_.sections.size());
    d_.sections.push_back(Access::MakeSection(&doc_, Intern(name, nameEnd), PosOf(name)));
    pending_.push_back(kSectionBit | index);
    open_.push_back({index, static_cast<std::uint32_t>(pending_.size())});
    Attach(kSectionBit | index);
    return true;
}

void Reader::CloseSection() {
    const Open o = open_.back();
    open_.pop_back();
    Section& s = d_.sections[o.section];
    if (!pendingComment_.empty()) {
        d_.closingComments[o.section] = std::move(pendingComment_);
        pendingComment_.clear();
    }
    Access::FirstEntry(s) = static_cast<std::uint32_t>(d_.entries.size());
    Access::EntryCount(s) = static_cast<std::uint32_t>(pending_.size() - o.pendingStart);
    d_.entries.insert(d_.entries.end(), pending_.begin() + o.pendingStart, pending_.end());
    pending_.resize(o.pendingStart);
}

bool Reader::ReadKeyword(const char* name, const char* nameEnd) {
    Attach(static_cast<std::uint32_t>(d_.keywords.size()));
    pending_.push_back(static_cast<std::uint32_t>(d_.keywords.size()));
    d_.keywords.push_back(Access::MakeKeyword(&doc_, open_.back().section, Intern(name, nameEnd),
                                              static_cast<std::uint32_t>(d_.params.size()),
                                              PosOf(name)));
    SkipBlanks();
    if (LineEnds(p_))
        return true;
    for (;;) {
        if (!ReadValue())
            return false;
        SkipBlanks();
        if (*p_ == ',') {
            ++p_;
            SkipBlanks();
            if (LineEnds(p_))
                return Fail(p_, "expected a value after ','");
            continue;
        }
        if (LineEnds(p_))
            return true;
        return Fail(p_, "expected ',' or end of line after a value");
    }
}

bool Reader::ReadValue() {
    const char c = *p_;
    if (c == '"')
        return ReadString();
    if (c == '\'')
        return ReadFileName();
    if ((Cls(c) & kDigit) || c == '-' || c == '.')
        return ReadNumber();
    if (Cls(c) & kStart)
        return ReadWord();
    return Fail(p_, "expected a value");
}

bool Reader::ReadString() {
    const char* open = p_++;
    const char* q = p_;
    while (!(Cls(*q) & kStrStop))
        ++q;
    if (*q == '"') {
        Push(Access::Text(ParamType::String, d_.text.Store({p_, std::size_t(q - p_)}),
                          std::size_t(q - p_)));
        CheckUtf8(p_, q, "string");
        p_ = q + 1;
        return true;
    }
    scratch_.assign(p_, q);
    p_ = q;
    for (;;) {
        const char c = *p_;
        if (c == '"')
            break;
        if (c == '\n' || (c == '\0' && p_ == end_))
            return Fail(open, "unterminated string");
        if (c == '\\') {
            const char e = p_[1];
            switch (e) {
            case '"':
            case '\\':
                scratch_ += e;
                break;
            case 'n':
                scratch_ += '\n';
                break;
            case 't':
                scratch_ += '\t';
                break;
            case 'r':
                scratch_ += '\r';
                break;
            default:
                if (e == '\n' || (e == '\0' && p_ + 1 == end_))
                    return Fail(open, "unterminated string");
                if (static_cast<unsigned char>(e) > 32 && static_cast<unsigned char>(e) < 127)
                    return Fail(p_, Cat("unknown escape '\\", e, "' in string"));
                return Fail(p_, "unknown escape in string");
            }
            p_ += 2;
            continue;
        }
        const char* run = p_++; // an embedded NUL byte is kept as it is
        while (!(Cls(*p_) & kStrStop))
            ++p_;
        scratch_.append(run, p_);
    }
    CheckUtf8(open + 1, p_, "string");
    ++p_;
    Push(Access::Text(ParamType::String, d_.text.Store(scratch_), scratch_.size()));
    return true;
}

bool Reader::ReadFileName() {
    const char* open = p_++;
    scratch_.clear();
    for (;;) {
        const char* run = p_;
        for (;;) {
            while (!(Cls(*p_) & kFileStop))
                ++p_;
            if (*p_ != '\0' || p_ == end_)
                break;
            ++p_; // an embedded NUL byte is kept as it is
        }
        if (*p_ != '\'')
            return Fail(open, "unterminated file name");
        if (p_[1] != '\'') {
            CheckUtf8(open + 1, p_, "file name");
            if (scratch_.empty() && run == open + 1) {
                const std::string_view s(run, std::size_t(p_ - run));
                Push(Access::Text(ParamType::FileName, d_.text.Store(s), s.size()));
            } else {
                scratch_.append(run, p_);
                Push(Access::Text(ParamType::FileName, d_.text.Store(scratch_), scratch_.size()));
            }
            ++p_;
            return true;
        }
        scratch_.append(run, p_ + 1); // '' stands for one quote
        p_ += 2;
    }
}

bool Reader::ReadWord() {
    const char* w = p_;
    while (Cls(*p_) & kName)
        ++p_;
    const std::string_view word(w, std::size_t(p_ - w));
    if (word == "true")
        Push(Access::Bool(true));
    else if (word == "false")
        Push(Access::Bool(false));
    else if (word == "nan")
        Push(Access::Double(std::numeric_limits<double>::quiet_NaN()));
    else if (word == "inf")
        Push(Access::Double(std::numeric_limits<double>::infinity()));
    else
        return Fail(w, Cat("unknown value '", word, "' (text needs double quotes)"));
    return true;
}

bool Reader::ReadNumber() {
    const char* start = p_;
    const char* q = p_;
    const bool neg = *q == '-';
    if (neg) {
        ++q;
        if (q[0] == 'i' && q[1] == 'n' && q[2] == 'f' && (Cls(q[3]) & kEnd)) {
            Push(Access::Double(-std::numeric_limits<double>::infinity()));
            p_ = q + 3;
            return true;
        }
    }
    std::uint64_t m = 0; // up to 19 significant digits
    int sig = 0;
    std::int64_t exp10 = 0;
    int digits = 0;
    bool truncated = false;
    bool real = false;
    while (*q == '0') {
        ++q;
        ++digits;
    }
    while (Cls(*q) & kDigit) {
        if (sig < 19) {
            m = m * 10 + unsigned(*q - '0');
            ++sig;
        } else {
            ++exp10;
            truncated |= *q != '0';
        }
        ++q;
        ++digits;
    }
    if (*q == '.') {
        real = true;
        ++q;
        if (sig == 0) {
            while (*q == '0') {
                ++q;
                --exp10;
                ++digits;
            }
        }
        while (Cls(*q) & kDigit) {
            if (sig < 19) {
                m = m * 10 + unsigned(*q - '0');
                ++sig;
                --exp10;
            } else {
                truncated |= *q != '0';
            }
            ++q;
            ++digits;
        }
    }
    if (digits == 0)
        return Fail(start, Cat("invalid number '", Token(start), "'"));
    if (*q == 'e' || *q == 'E') {
        real = true;
        ++q;
        const bool eneg = *q == '-';
        if (*q == '+' || *q == '-')
            ++q;
        if (!(Cls(*q) & kDigit))
            return Fail(start, Cat("invalid number '", Token(start), "'"));
        int e = 0;
        while (Cls(*q) & kDigit) {
            if (e < 100000)
                e = e * 10 + (*q - '0');
            ++q;
        }
        exp10 += eneg ? -e : e;
    }
    if (!(Cls(*q) & kEnd))
        return Fail(start, Cat("invalid number '", Token(start), "'"));
    p_ = q;

    if (!real) {
        if (exp10 > 0 || m > std::uint64_t(INT64_MAX) + (neg ? 1 : 0))
            return Fail(start, Cat("integer ", std::string_view(start, std::size_t(q - start)),
                                   " is out of range"));
        Push(Access::Int(neg ? static_cast<std::int64_t>(0 - m) : static_cast<std::int64_t>(m)));
        return true;
    }
    double d;
    if (m == 0) {
        d = neg ? -0.0 : 0.0;
    } else if (!truncated && m <= (std::uint64_t(1) << 53) && exp10 >= -22 && exp10 <= 22) {
        // Both operands exact, so the one rounding is the correct one.
        d = static_cast<double>(m);
        d = exp10 < 0 ? d / kPow10[-exp10] : d * kPow10[exp10];
        if (neg)
            d = -d;
    } else {
        const auto r = std::from_chars(start, q, d);
        if (r.ec == std::errc::result_out_of_range)
            return Fail(start, Cat("number ", std::string_view(start, std::size_t(q - start)),
                                   " is out of range"));
        if (r.ec != std::errc() || r.ptr != q)
            return Fail(start, Cat("invalid number '", Token(start), "'"));
    }
    Param p = Access::Double(d);
    if (MayMisroundAsFloat(d))
        Access::SetFloat(p, FloatOfText(start, q, d));
    Push(p);
    return true;
}

} // namespace

ParseResult ParseText(std::string text, std::string fileName) {
    ParseResult result;
    auto doc = std::make_unique<Document>();
    doc->SetFileName(std::move(fileName));
    if (text.size() >= std::size_t(INT_MAX)) {
        result.error = Diagnostic{doc->FileName(), {1, 1}, "file too large"};
        return result;
    }
    doc->impl().sourceBytes = text.size();
    Reader reader(text, *doc);
    if (!reader.Run()) {
        result.error = std::move(reader.error);
        result.beforeFirstSection = !reader.OpenedASection();
        return result;
    }
    result.document = std::move(doc);
    return result;
}

ParseResult ParseFile(const std::string& path) {
    std::string text;
    fileio::FileIdentity identity;
    if (auto failure = fileio::ReadWholeFile(path, fileio::kSetupFiles, text, &identity)) {
        ParseResult r;
        r.error = Diagnostic{path, {0, 0}, "cannot read '" + path + "': " + failure->SystemText()};
        return r;
    }
    ParseResult r = ParseText(std::move(text), path);
    r.identity = identity;
    return r;
}

} // namespace paramfile
