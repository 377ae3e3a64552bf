#include "paramfile/ParamFileImpl.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <new>
#include <unordered_set>

#include <sys/mman.h>

namespace paramfile {

// --- storage -----------------------------------------------------------------------------

char* Arena::Grow(std::size_t n) {
    constexpr std::size_t kMaxBlock = std::size_t(1) << 20;
    if (n > next_ / 4) {
        // A large value gets a block of its own so the current block keeps its room.
        blocks_.emplace_back(new char[n]);
        bytes_ += n;
        return blocks_.back().get();
    }
    blocks_.emplace_back(new char[next_]);
    bytes_ += next_;
    cur_ = blocks_.back().get() + n;
    left_ = next_ - n;
    next_ = std::min(next_ * 2, kMaxBlock);
    return blocks_.back().get();
}

namespace {
constexpr std::size_t kHugePage = std::size_t(2) << 20;
constexpr std::size_t kMapAbove = 2 * kHugePage;
std::size_t RoundToHugePage(std::size_t n) {
    return (n + kHugePage - 1) & ~(kHugePage - 1);
}
} // namespace

void* AllocateTable(std::size_t bytes) {
    if (bytes < kMapAbove)
        return ::operator new(bytes);
    const std::size_t size = RoundToHugePage(bytes);
    // Over-map by one huge page so the table can start on a huge-page boundary.
    void* m = ::mmap(nullptr, size + kHugePage, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS,
                     -1, 0);
    if (m == MAP_FAILED)
        throw std::bad_alloc();
    const auto raw = reinterpret_cast<std::uintptr_t>(m);
    const std::uintptr_t start = (raw + kHugePage - 1) & ~(std::uintptr_t(kHugePage) - 1);
    if (start > raw)
        ::munmap(m, start - raw);
    if (const std::size_t tail = raw + size + kHugePage - (start + size); tail > 0)
        ::munmap(reinterpret_cast<void*>(start + size), tail);
    ::madvise(reinterpret_cast<void*>(start), size, MADV_HUGEPAGE);
    return reinterpret_cast<void*>(start);
}

void FreeTable(void* p, std::size_t bytes) {
    if (bytes < kMapAbove)
        ::operator delete(p);
    else
        ::munmap(p, RoundToHugePage(bytes));
}

std::size_t TableBytes(std::size_t bytes) {
    return bytes < kMapAbove ? bytes : RoundToHugePage(bytes);
}

namespace {

std::uint64_t Load8(const char* p) {
    std::uint64_t v;
    std::memcpy(&v, p, 8);
    return v;
}

std::uint32_t Load4(const char* p) {
    std::uint32_t v;
    std::memcpy(&v, p, 4);
    return v;
}

std::uint64_t Mix(std::uint64_t a, std::uint64_t b) {
    std::uint64_t h = a * 0x9E3779B97F4A7C15ull ^ b * 0xC2B2AE3D27D4EB4Full;
    h ^= h >> 29;
    h *= 0xBF58476D1CE4E5B9ull;
    return h ^ (h >> 32);
}

// Names are short: two overlapping loads beat a call to memcmp.
bool SameName(std::string_view a, std::string_view b) {
    const std::size_t n = a.size();
    if (n != b.size())
        return false;
    if (n >= 8 && n <= 16)
        return Load8(a.data()) == Load8(b.data()) &&
               Load8(a.data() + n - 8) == Load8(b.data() + n - 8);
    if (n >= 4 && n < 8)
        return Load4(a.data()) == Load4(b.data()) &&
               Load4(a.data() + n - 4) == Load4(b.data() + n - 4);
    return a == b;
}

} // namespace

std::uint64_t HashName(const char* s, std::size_t n) {
    std::uint64_t a = 0;
    std::uint64_t b = n;
    if (n > 16) {
        for (std::size_t i = 0; i + 8 < n; i += 8)
            a = Mix(a ^ Load8(s + i), n);
        b ^= Load8(s + n - 8);
    } else if (n >= 8) {
        a = Load8(s);
        b ^= Load8(s + n - 8) << 1;
    } else if (n >= 4) {
        a = Load4(s);
        b ^= std::uint64_t(Load4(s + n - 4)) << 8;
    } else if (n > 0) {
        a = std::uint8_t(s[0]) | std::uint32_t(std::uint8_t(s[n / 2])) << 8 |
            std::uint32_t(std::uint8_t(s[n - 1])) << 16;
    }
    return Mix(a, b);
}

NameTable::NameTable() : slots_(64, 0) {
    Arena none;
    Intern(std::string_view(), none);
}

std::uint32_t NameTable::Intern(std::string_view name, std::uint64_t hash, Arena& arena) {
    const std::size_t mask = slots_.size() - 1;
    for (std::size_t i = hash & mask;; i = (i + 1) & mask) {
        const std::uint32_t slot = slots_[i];
        if (slot == 0) {
            const auto id = static_cast<std::uint32_t>(names_.size());
            names_.emplace_back(arena.Store(name), name.size());
            hashes_.push_back(hash);
            slots_[i] = id + 1;
            if (names_.size() * 2 > slots_.size())
                Rehash();
            return id;
        }
        if (hashes_[slot - 1] == hash && SameName(names_[slot - 1], name))
            return slot - 1;
    }
}

std::int64_t NameTable::Find(std::string_view name) const {
    const std::uint64_t hash = HashName(name.data(), name.size());
    const std::size_t mask = slots_.size() - 1;
    for (std::size_t i = hash & mask;; i = (i + 1) & mask) {
        const std::uint32_t slot = slots_[i];
        if (slot == 0)
            return -1;
        if (hashes_[slot - 1] == hash && SameName(names_[slot - 1], name))
            return slot - 1;
    }
}

void NameTable::Rehash() {
    std::vector<std::uint32_t> slots(slots_.size() * 2, 0);
    const std::size_t mask = slots.size() - 1;
    for (std::uint32_t id = 0; id < names_.size(); ++id) {
        std::size_t i = hashes_[id] & mask;
        while (slots[i] != 0)
            i = (i + 1) & mask;
        slots[i] = id + 1;
    }
    slots_.swap(slots);
}

std::size_t NameTable::Bytes() const {
    return names_.capacity() * sizeof(std::string_view) +
           hashes_.capacity() * sizeof(std::uint64_t) + slots_.capacity() * sizeof(std::uint32_t);
}

std::size_t Document::Impl::MemoryBytes() const {
    std::size_t n = sizeof(Document) + sizeof(Impl) + fileName.capacity();
    n += TableBytes(sections.capacity() * sizeof(Section));
    n += TableBytes(keywords.capacity() * sizeof(Keyword));
    n += TableBytes(params.capacity() * sizeof(Param));
    n += TableBytes(entries.capacity() * sizeof(std::uint32_t));
    n += names.Bytes() + text.Bytes();
    for (const Diagnostic& w : warnings)
        n += sizeof w + w.file.capacity() + w.message.capacity();
    return n;
}

// --- numbers -----------------------------------------------------------------------------

namespace {

char* FinishReal(char* begin, char* end) {
    for (const char* p = begin; p != end; ++p)
        if (*p == '.' || *p == 'e')
            return end;
    end[0] = '.';
    end[1] = '0';
    return end + 2;
}

template <class T> char* FormatReal(char* buf, T v) {
    if (std::isnan(v)) {
        std::memcpy(buf, "nan", 3);
        return buf + 3;
    }
    if (std::isinf(v)) {
        if (v < 0) {
            std::memcpy(buf, "-inf", 4);
            return buf + 4;
        }
        std::memcpy(buf, "inf", 3);
        return buf + 3;
    }
    return FinishReal(buf, std::to_chars(buf, buf + 30, v).ptr);
}

} // namespace

char* FormatDouble(char* buf, double v) {
    return FormatReal(buf, v);
}
char* FormatFloat(char* buf, float v) {
    return FormatReal(buf, v);
}

bool MayMisroundAsFloat(double d) {
    const double a = std::fabs(d);
    if (!(a < 0x1p128))
        return false; // past the overflow boundary whatever the decimal digits were
    if (a >= 0x1p-126) {
        // A double exactly halfway between two floats may hide which side the text was on.
        std::uint64_t b;
        std::memcpy(&b, &d, sizeof b);
        return (b & 0x1FFFFFFFu) == 0x10000000u;
    }
    return a != 0 && static_cast<double>(static_cast<float>(d)) != d;
}

float FloatOfText(const char* begin, const char* end, double d) {
    float f;
    if (std::from_chars(begin, end, f).ec == std::errc())
        return f;
    const float big = std::fabs(d) > 1 ? std::numeric_limits<float>::infinity() : 0.0f;
    return std::signbit(d) ? -big : big;
}

// --- Param -------------------------------------------------------------------------------

ParamType Param::Type() const {
    return type_;
}

bool Param::AsInt(std::int32_t& out) const {
    if (type_ != ParamType::Integer)
        return false;
    const auto v = static_cast<std::int64_t>(bits_);
    if (v < std::numeric_limits<std::int32_t>::min() ||
        v > std::numeric_limits<std::int32_t>::max())
        return false;
    out = static_cast<std::int32_t>(v);
    return true;
}

bool Param::AsDouble(double& out) const {
    switch (type_) {
    case ParamType::Integer: {
        const auto v = static_cast<std::int64_t>(bits_);
        const auto d = static_cast<double>(v);
        if (d >= 0x1p63 || static_cast<std::int64_t>(d) != v)
            return false;
        out = d;
        return true;
    }
    case ParamType::Double:
        out = Access::DoubleOf(*this);
        return true;
    case ParamType::Float:
        out = Access::FloatOf(*this);
        return true;
    default:
        return false;
    }
}

bool Param::AsFloat(float& out) const {
    switch (type_) {
    case ParamType::Integer: {
        const auto v = static_cast<std::int64_t>(bits_);
        const auto f = static_cast<float>(v);
        if (f >= 0x1p63f || static_cast<std::int64_t>(f) != v)
            return false;
        out = f;
        return true;
    }
    case ParamType::Double: {
        const double d = Access::DoubleOf(*this);
        float f;
        if (flags_ & kHasFloat)
            std::memcpy(&f, &aux_, sizeof f);
        else
            f = static_cast<float>(d);
        if (std::isinf(f) && !std::isinf(d))
            return false;
        out = f;
        return true;
    }
    case ParamType::Float:
        out = Access::FloatOf(*this);
        return true;
    default:
        return false;
    }
}

bool Param::AsBool(bool& out) const {
    if (type_ == ParamType::Boolean || (type_ == ParamType::Integer && bits_ <= 1)) {
        out = bits_ != 0;
        return true;
    }
    return false;
}

bool Param::AsString(std::string& out) const {
    if (type_ != ParamType::String && type_ != ParamType::FileName)
        return false;
    out.assign(Access::TextOf(*this));
    return true;
}

const char* Param::TypeName() const {
    switch (type_) {
    case ParamType::Integer:
        return "an integer";
    case ParamType::Double:
    case ParamType::Float:
        return "a real number";
    case ParamType::Boolean:
        return "a boolean";
    case ParamType::String:
        return "a string";
    case ParamType::FileName:
        return "a file name";
    }
    return "a value";
}

// --- Keyword, Section, Document ----------------------------------------------------------

namespace {
const Param kNoParam;
const Keyword kNoKeyword;
const Section kNoSection;
} // namespace

std::string_view Keyword::Name() const {
    return doc_ ? doc_->impl().names[name_] : "";
}
int Keyword::ParamCount() const {
    return static_cast<int>(count_);
}
const Param& Keyword::ParamAt(int index) const {
    if (index < 0 || static_cast<std::uint32_t>(index) >= count_)
        return kNoParam;
    return doc_->impl().params[first_ + index];
}
Position Keyword::Pos() const {
    return pos_;
}
const Section& Keyword::Owner() const {
    return doc_ ? doc_->impl().sections[owner_] : kNoSection;
}
bool Keyword::WasFound() const {
    if (!doc_)
        return false;
    const Document::Impl& d = doc_->impl();
    return d.WasFound(static_cast<std::uint32_t>(this - d.keywords.data()), false);
}

std::string_view Section::Name() const {
    return doc_ ? doc_->impl().names[name_] : "";
}
Position Section::Pos() const {
    return pos_;
}
const Document& Section::Doc() const {
    return *doc_;
}
int Section::EntryCount() const {
    return static_cast<int>(entryCount_);
}

bool Section::EntryIsSection(int index) const {
    if (index < 0 || static_cast<std::uint32_t>(index) >= entryCount_)
        return false;
    return (doc_->impl().entries[firstEntry_ + index] & kSectionBit) != 0;
}

const Keyword& Section::KeywordAt(int index) const {
    if (index < 0 || static_cast<std::uint32_t>(index) >= entryCount_)
        return kNoKeyword;
    const Document::Impl& d = doc_->impl();
    const std::uint32_t e = d.entries[firstEntry_ + index];
    return (e & kSectionBit) ? kNoKeyword : d.keywords[e];
}

const Section& Section::SectionAt(int index) const {
    if (index < 0 || static_cast<std::uint32_t>(index) >= entryCount_)
        return kNoSection;
    const Document::Impl& d = doc_->impl();
    const std::uint32_t e = d.entries[firstEntry_ + index];
    return (e & kSectionBit) ? d.sections[e & ~kSectionBit] : kNoSection;
}

const Section* Section::FindSection(std::string_view name, int n) const {
    if (!doc_)
        return nullptr;
    const Document::Impl& d = doc_->impl();
    const std::int64_t at = d.FindEntry(static_cast<std::uint32_t>(this - d.sections.data()),
                                        firstEntry_, entryCount_, name, n, true);
    if (at < 0)
        return nullptr;
    d.MarkFound(static_cast<std::uint32_t>(at), true);
    return &d.sections[static_cast<size_t>(at)];
}

bool Section::WasFound() const {
    if (!doc_)
        return false;
    const Document::Impl& d = doc_->impl();
    return d.WasFound(static_cast<std::uint32_t>(this - d.sections.data()), true);
}

const Keyword* Section::FindKeyword(std::string_view name, int n) const {
    if (!doc_)
        return nullptr;
    const Document::Impl& d = doc_->impl();
    const std::int64_t at = d.FindEntry(static_cast<std::uint32_t>(this - d.sections.data()),
                                        firstEntry_, entryCount_, name, n, false);
    if (at < 0)
        return nullptr;
    d.MarkFound(static_cast<std::uint32_t>(at), false);
    return &d.keywords[static_cast<size_t>(at)];
}

const Document::Impl::LookupIndex& Document::Impl::IndexOf(std::uint32_t sectionIndex,
                                                          std::uint32_t firstEntry,
                                                          std::uint32_t entryCount) const {
    LookupIndex& index = lookupIndexes[sectionIndex];
    // A section still being built grows; its index is made again when it has.
    if (index.firstEntry == firstEntry && index.entryCount == entryCount &&
        (!index.sections.empty() || !index.keywords.empty()))
        return index;
    index = LookupIndex{firstEntry, entryCount, {}, {}};
    const std::uint32_t* e = entries.data() + firstEntry;
    for (std::uint32_t i = 0; i < entryCount; ++i) {
        if (e[i] & kSectionBit) {
            const std::uint32_t at = e[i] & ~kSectionBit;
            index.sections[sections[at].name_].push_back(at);
        } else {
            index.keywords[keywords[e[i]].name_].push_back(e[i]);
        }
    }
    return index;
}

std::int64_t Document::Impl::FindEntry(std::uint32_t sectionIndex, std::uint32_t firstEntry,
                                       std::uint32_t entryCount, std::string_view name, int n,
                                       bool wantSection) const {
    if (n < 1)
        return -1;
    const std::int64_t id = names.Find(name);
    if (id < 0)
        return -1;
    if (entryCount >= kIndexedEntries) {
        const LookupIndex& index = IndexOf(sectionIndex, firstEntry, entryCount);
        const auto& byName = wantSection ? index.sections : index.keywords;
        auto it = byName.find(id);
        if (it == byName.end() || static_cast<size_t>(n) > it->second.size())
            return -1;
        return it->second[static_cast<size_t>(n) - 1];
    }
    const std::uint32_t* e = entries.data() + firstEntry;
    for (std::uint32_t i = 0; i < entryCount; ++i) {
        const bool isSection = (e[i] & kSectionBit) != 0;
        if (isSection != wantSection)
            continue;
        const std::uint32_t at = e[i] & ~kSectionBit;
        const std::int64_t entryName = isSection ? sections[at].name_ : keywords[at].name_;
        if (entryName == id && --n == 0)
            return at;
    }
    return -1;
}

std::string Diagnostic::ToString() const {
    return file + ':' + std::to_string(pos.line) + ':' + std::to_string(pos.column) + ": " +
           message;
}

Document::Document() : impl_(std::make_unique<Impl>()) {
    impl_->self = this;
    impl_->sections.push_back(Access::MakeSection(this, 0, {}));
}

Document::~Document() = default;

const std::string& Document::FileName() const {
    return impl_->fileName;
}
void Document::SetFileName(std::string name) {
    impl_->fileName = std::move(name);
}
const Section& Document::Root() const {
    return impl_->sections[0];
}
const std::vector<Diagnostic>& Document::Warnings() const {
    return impl_->warnings;
}

void Document::AddWarning(Position pos, std::string message) const {
    impl_->warnings.push_back(Diagnostic{impl_->fileName, pos, std::move(message)});
}

Position Document::End() const {
    return impl_->end;
}

std::vector<Diagnostic> UnreadEntries(const Section& section, const std::string& path) {
    std::vector<Diagnostic> out;
    const Document* doc = Access::DocOf(section);
    if (!doc)
        return out;
    const Document::Impl& d = doc->impl();
    struct Todo {
        const Section* section;
        std::string path;
    };
    std::vector<Todo> todo{{&section, path}};
    std::unordered_set<std::uint32_t> foundNames[2]; // [1] sections
    while (!todo.empty()) {
        const Todo t = std::move(todo.back());
        todo.pop_back();
        const std::uint32_t* e = d.entries.data() + Access::FirstEntry(*t.section);
        const std::uint32_t n = Access::EntryCount(*t.section);
        bool namesKnown = false;
        for (std::uint32_t i = 0; i < n; ++i) {
            const bool isSection = (e[i] & kSectionBit) != 0;
            const std::uint32_t at = e[i] & ~kSectionBit;
            const std::uint32_t name =
                isSection ? Access::NameId(d.sections[at]) : Access::NameId(d.keywords[at]);
            if (d.WasFound(at, isSection)) {
                if (isSection)
                    todo.push_back({&d.sections[at], Cat(t.path, "/", d.names[name])});
                continue;
            }
            if (!namesKnown) {
                // A second occurrence of a name read once is a repetition, not an unknown.
                foundNames[0].clear();
                foundNames[1].clear();
                for (std::uint32_t j = 0; j < n; ++j) {
                    const bool s = (e[j] & kSectionBit) != 0;
                    const std::uint32_t a = e[j] & ~kSectionBit;
                    if (d.WasFound(a, s))
                        foundNames[s].insert(s ? Access::NameId(d.sections[a])
                                               : Access::NameId(d.keywords[a]));
                }
                namesKnown = true;
            }
            const char* what = isSection ? "section" : "keyword";
            const Position pos = isSection ? d.sections[at].Pos() : d.keywords[at].Pos();
            std::string message =
                foundNames[isSection].count(name)
                    ? Cat(what, " '", d.names[name], "' repeated in ", t.path,
                          ": only the first is read, this one is dropped on saving")
                    : Cat("unknown ", what, " '", d.names[name], "' in ", t.path,
                          ": not read, dropped on saving");
            out.push_back(Diagnostic{d.fileName, pos, std::move(message)});
        }
    }
    std::sort(out.begin(), out.end(), [](const Diagnostic& a, const Diagnostic& b) {
        return a.pos.line != b.pos.line ? a.pos.line < b.pos.line : a.pos.column < b.pos.column;
    });
    return out;
}

// --- Builder -----------------------------------------------------------------------------

struct Builder::State {
    struct Open {
        std::uint32_t section;
        std::uint32_t capacity; // entry slots the section owns from its first entry
    };
    std::vector<Open> open;
    std::int64_t keyword = -1; // receives the parameters added next
    int skipped = 0;           // sections opened past the depth limit, dropped whole
    std::string name;          // scratch for names that need repair
    // Where comments come from: the source's counterparts of the open sections (null where
    // the source has none); not followed while a section is copied.
    const Document* commentSource = nullptr;
    std::vector<const Section*> sourceOpen;
    int copying = 0;
    std::function<std::string(std::string_view)> mapFileName;
};

Builder::Builder(Document& doc) : doc_(doc), state_(std::make_unique<State>()) {
    const Section& root = doc.Root();
    state_->open.push_back({0, Access::EntryCount(root)});
}

Builder::~Builder() = default;

namespace {

bool IsNameStart(char c) {
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_';
}
bool IsNameChar(char c) {
    return IsNameStart(c) || (c >= '0' && c <= '9');
}

// The writer must produce text that reads back, so a name that could not be read is
// repaired rather than refused (refusing would unbalance the sections).
std::string_view ValidName(std::string_view name, std::string& scratch) {
    bool ok = !name.empty() && IsNameStart(name[0]);
    for (std::size_t i = 1; ok && i < name.size(); ++i)
        ok = IsNameChar(name[i]);
    if (ok)
        return name;
    scratch.clear();
    if (name.empty() || !IsNameStart(name[0]))
        scratch += '_';
    for (char c : name)
        scratch += IsNameChar(c) ? c : '_';
    return scratch;
}

// Appends to the innermost open section. While building, a section's entries may be
// followed by those of a later section; it then moves to the end with room to grow.
void AppendEntry(Document::Impl& d, Builder::State& st, std::uint32_t entry) {
    Builder::State::Open& o = st.open.back();
    Section& s = d.sections[o.section];
    std::uint32_t& first = Access::FirstEntry(s);
    std::uint32_t& count = Access::EntryCount(s);
    if (first + count == d.entries.size()) {
        d.entries.push_back(entry);
        o.capacity = std::max(o.capacity, count + 1);
    } else if (count < o.capacity) {
        d.entries[first + count] = entry;
    } else {
        const std::size_t to = d.entries.size();
        const std::uint32_t capacity = std::max<std::uint32_t>(4, count * 2);
        d.entries.resize(to + capacity, 0);
        std::copy_n(d.entries.begin() + first, count, d.entries.begin() + to);
        d.entries[to + count] = entry;
        first = static_cast<std::uint32_t>(to);
        o.capacity = capacity;
    }
    ++count;
}

void CopyComments(const Document::Impl& from, std::uint32_t fromKey, Document::Impl& to,
                  std::uint32_t toKey) {
    if (from.comments.empty() && from.closingComments.empty())
        return;
    if (auto it = from.comments.find(fromKey); it != from.comments.end())
        to.comments[toKey] = it->second;
    if (fromKey & kSectionBit)
        if (auto it = from.closingComments.find(fromKey & ~kSectionBit);
            it != from.closingComments.end())
            to.closingComments[toKey & ~kSectionBit] = it->second;
}

// The source's entry of that name in the source's counterpart of the open section, or -1.
std::int64_t SourceEntry(const Builder::State& st, std::string_view name, bool wantSection) {
    const Section* parent = st.sourceOpen.empty() ? nullptr : st.sourceOpen.back();
    if (!parent)
        return -1;
    const Document::Impl& src = st.commentSource->impl();
    return src.FindEntry(static_cast<std::uint32_t>(parent - src.sections.data()),
                         Access::FirstEntry(*parent), Access::EntryCount(*parent), name, 1,
                         wantSection);
}

bool FollowsSource(const Builder::State& st) {
    return st.commentSource && st.copying == 0;
}

} // namespace

void Builder::TakeCommentsFrom(const Document& source) {
    State& st = *state_;
    st.commentSource = &source;
    st.sourceOpen.assign(st.open.size(), nullptr);
    st.sourceOpen.front() = &source.Root();
    if (auto it = source.impl().closingComments.find(0);
        it != source.impl().closingComments.end())
        doc_.impl().closingComments[0] = it->second;
}

void Builder::BeginSection(std::string_view name) {
    State& st = *state_;
    st.keyword = -1;
    if (st.skipped > 0 || Depth() >= kMaxDepth) {
        ++st.skipped;
        return;
    }
    Document::Impl& d = doc_.impl();
    const std::uint32_t id = d.names.Intern(ValidName(name, st.name), d.text);
    const auto index = static_cast<std::uint32_t>(d.sections.size());
    AppendEntry(d, st, kSectionBit | index);
    d.sections.push_back(Access::MakeSection(&doc_, id, {}));
    Access::FirstEntry(d.sections.back()) = static_cast<std::uint32_t>(d.entries.size());
    st.open.push_back({index, 0});
    if (FollowsSource(st)) {
        const std::int64_t at = SourceEntry(st, d.names[id], true);
        const Document::Impl& src = st.commentSource->impl();
        st.sourceOpen.push_back(at < 0 ? nullptr : &src.sections[static_cast<size_t>(at)]);
        if (at >= 0)
            CopyComments(src, kSectionBit | static_cast<std::uint32_t>(at), d,
                         kSectionBit | index);
    }
}

void Builder::EndSection() {
    State& st = *state_;
    st.keyword = -1;
    if (st.skipped > 0) {
        --st.skipped;
    } else if (st.open.size() > 1) {
        st.open.pop_back();
        if (FollowsSource(st) && st.sourceOpen.size() > 1)
            st.sourceOpen.pop_back();
    }
}

void Builder::AddKeyword(std::string_view name) {
    State& st = *state_;
    st.keyword = -1;
    if (st.skipped > 0 || st.open.size() == 1)
        return; // the top level holds only sections
    Document::Impl& d = doc_.impl();
    const std::uint32_t id = d.names.Intern(ValidName(name, st.name), d.text);
    const auto index = static_cast<std::uint32_t>(d.keywords.size());
    AppendEntry(d, st, index);
    d.keywords.push_back(Access::MakeKeyword(&doc_, st.open.back().section, id,
                                             static_cast<std::uint32_t>(d.params.size()), {}));
    st.keyword = index;
    if (FollowsSource(st) && !st.commentSource->impl().comments.empty()) {
        const std::int64_t at = SourceEntry(st, d.names[id], false);
        if (at >= 0)
            CopyComments(st.commentSource->impl(), static_cast<std::uint32_t>(at), d, index);
    }
}

namespace {
void AddParam(Document::Impl& d, std::int64_t keyword, const Param& p) {
    if (keyword < 0)
        return;
    d.params.push_back(p);
    ++Access::ParamCount(d.keywords[keyword]);
}
} // namespace

void Builder::AddInt(std::int32_t v) {
    AddParam(doc_.impl(), state_->keyword, Access::Int(v));
}
void Builder::AddDouble(double v) {
    Param p = Access::Double(v);
    if (MayMisroundAsFloat(v)) {
        // Read as float, the value must agree with what its written text will give.
        char text[32];
        Access::SetFloat(p, FloatOfText(text, FormatDouble(text, v), v));
    }
    AddParam(doc_.impl(), state_->keyword, p);
}
void Builder::AddFloat(float v) {
    AddParam(doc_.impl(), state_->keyword, Access::Float(v));
}
void Builder::AddBool(bool v) {
    AddParam(doc_.impl(), state_->keyword, Access::Bool(v));
}

void Builder::AddString(std::string_view v) {
    if (state_->keyword < 0)
        return;
    Document::Impl& d = doc_.impl();
    AddParam(d, state_->keyword, Access::Text(ParamType::String, d.text.Store(v), v.size()));
}

void Builder::AddFileName(std::string_view v) {
    if (state_->keyword < 0)
        return;
    std::string mapped;
    if (state_->mapFileName) {
        mapped = state_->mapFileName(v);
        v = mapped;
    }
    Document::Impl& d = doc_.impl();
    AddParam(d, state_->keyword, Access::Text(ParamType::FileName, d.text.Store(v), v.size()));
}

void Builder::MapFileNames(std::function<std::string(std::string_view)> map) {
    state_->mapFileName = std::move(map);
}

void Builder::CopySection(const Section& section) {
    if (!Access::DocOf(section))
        return;
    if (Access::DocOf(section) == &doc_) {
        // Copying from ourselves would read entries that move as we append.
        Document copy;
        Builder(copy).CopySection(section);
        CopySection(copy.Root().SectionAt(0));
        return;
    }
    struct Frame {
        const Section* section;
        int next;
    };
    State& st = *state_;
    Document::Impl& d = doc_.impl();
    const Document::Impl& src = Access::Of(section);
    auto begin = [&](const Section& s) {
        BeginSection(s.Name());
        if (st.skipped == 0)
            CopyComments(src, kSectionBit | static_cast<std::uint32_t>(&s - src.sections.data()),
                         d, kSectionBit | static_cast<std::uint32_t>(d.sections.size() - 1));
    };
    ++st.copying;
    std::vector<Frame> stack{{&section, 0}};
    begin(section);
    while (!stack.empty()) {
        Frame& f = stack.back();
        if (f.next == f.section->EntryCount()) {
            EndSection();
            stack.pop_back();
            continue;
        }
        const int i = f.next++;
        if (f.section->EntryIsSection(i)) {
            const Section& child = f.section->SectionAt(i);
            begin(child);
            stack.push_back({&child, 0});
            continue;
        }
        const Keyword& k = f.section->KeywordAt(i);
        AddKeyword(k.Name());
        if (st.keyword >= 0)
            CopyComments(src, static_cast<std::uint32_t>(&k - src.keywords.data()), d,
                         static_cast<std::uint32_t>(st.keyword));
        for (int j = 0; j < k.ParamCount(); ++j) {
            const Param& p = k.ParamAt(j);
            if (p.Type() == ParamType::String || p.Type() == ParamType::FileName) {
                const std::string_view s = Access::TextOf(p);
                if (p.Type() == ParamType::String)
                    AddString(s);
                else
                    AddFileName(s);
            } else {
                AddParam(doc_.impl(), state_->keyword, p);
            }
        }
    }
    --st.copying;
}

int Builder::Depth() const {
    return static_cast<int>(state_->open.size()) - 1 + state_->skipped;
}

} // namespace paramfile
