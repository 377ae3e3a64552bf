// Internal layout of a parameter-file document, shared by the reader, the writer, the
// builder and the kiv calls. Not part of the library's interface.
#pragma once

#include "paramfile/ParamFile.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace paramfile {

// Entries of a section: keyword indices, or section indices with this bit set.
inline constexpr std::uint32_t kSectionBit = 0x80000000u;
inline constexpr int kMaxDepth = 1000;

enum : std::uint8_t { kHasFloat = 1 };

// Bump allocator for names and string values; blocks never move, so params may point
// into them.
class Arena {
public:
    char* Allocate(std::size_t n) {
        if (n <= left_) {
            char* r = cur_;
            cur_ += n;
            left_ -= n;
            return r;
        }
        return Grow(n);
    }
    const char* Store(std::string_view s) {
        if (s.empty())
            return "";
        char* p = Allocate(s.size());
        std::memcpy(p, s.data(), s.size());
        return p;
    }
    std::size_t Bytes() const { return bytes_; }

private:
    char* Grow(std::size_t n);
    std::vector<std::unique_ptr<char[]>> blocks_;
    char* cur_ = nullptr;
    std::size_t left_ = 0;
    std::size_t next_ = 4096;
    std::size_t bytes_ = 0;
};

std::uint64_t HashName(const char* s, std::size_t n);

// Interned names: keywords and sections repeat a handful of names, so each is held once.
class NameTable {
public:
    NameTable();
    std::uint32_t Intern(std::string_view name, std::uint64_t hash, Arena& arena);
    std::uint32_t Intern(std::string_view name, Arena& arena) {
        return Intern(name, HashName(name.data(), name.size()), arena);
    }
    // -1 when the name was never interned.
    std::int64_t Find(std::string_view name) const;
    std::string_view operator[](std::uint32_t id) const { return names_[id]; }
    std::size_t Bytes() const;

private:
    void Rehash();
    std::vector<std::string_view> names_;
    std::vector<std::uint64_t> hashes_;
    std::vector<std::uint32_t> slots_; // id + 1, 0 when free
};

// Large tables are mapped directly and asked for huge pages: filling tens of megabytes
// page by page costs a reader about a fifth of its time in page faults.
void* AllocateTable(std::size_t bytes);
void FreeTable(void* p, std::size_t bytes);
std::size_t TableBytes(std::size_t bytes); // what a table of that size really holds

template <class T> struct TableAllocator {
    using value_type = T;
    TableAllocator() = default;
    template <class U> TableAllocator(const TableAllocator<U>&) {}
    T* allocate(std::size_t n) { return static_cast<T*>(AllocateTable(n * sizeof(T))); }
    void deallocate(T* p, std::size_t n) { FreeTable(p, n * sizeof(T)); }
    friend bool operator==(TableAllocator, TableAllocator) { return true; }
};

template <class T> using Table = std::vector<T, TableAllocator<T>>;

struct Document::Impl {
    Document* self = nullptr;
    std::string fileName;
    Table<Section> sections; // [0] is the root
    Table<Keyword> keywords;
    Table<Param> params;
    Table<std::uint32_t> entries;
    NameTable names;
    Arena text;
    std::size_t sourceBytes = 0; // size of the text read, a hint for the writer
    Position end;                // where the text read ended
    mutable std::vector<Diagnostic> warnings;

    // Which entries a look-up by name has found: what no one asked for was not read. For a
    // keyword, 1 + the number of its values read (the highest read), 0 when never found.
    mutable std::vector<std::uint32_t> foundKeywords;
    mutable std::vector<std::uint8_t> foundSections;
    void MarkFound(std::uint32_t at, bool isSection) const {
        if (isSection) {
            if (foundSections.size() < sections.size())
                foundSections.resize(sections.size(), 0);
            foundSections[at] = 1;
        } else {
            MarkValuesRead(at, 0);
        }
    }
    bool WasFound(std::uint32_t at, bool isSection) const {
        if (isSection)
            return at < foundSections.size() && foundSections[at] != 0;
        return at < foundKeywords.size() && foundKeywords[at] != 0;
    }
    // Values 1 .. count of keyword at have been read.
    void MarkValuesRead(std::uint32_t at, std::uint32_t count) const {
        if (foundKeywords.size() < keywords.size())
            foundKeywords.resize(keywords.size(), 0);
        foundKeywords[at] = std::max(foundKeywords[at], count + 1);
    }
    std::uint32_t ValuesRead(std::uint32_t at) const {
        return at < foundKeywords.size() && foundKeywords[at] > 0 ? foundKeywords[at] - 1 : 0;
    }

    // Where a value follows the one before by more than 16 bits of columns (a string of
    // 64 kB), its column itself, by parameter index. Steps keep this map as small as such
    // values are rare, however long a line.
    static constexpr std::uint16_t kWideColumn = 0xFFFF;
    std::unordered_map<std::uint32_t, int> wideColumns;

    // Comments, kept with the entry that follows them (and the one on whose line they stand);
    // keyed by entry code (keyword index, or section index with kSectionBit). Those after a
    // section's last entry close it (the root's end the file). Empty in most files.
    struct Comments {
        std::string before; // whole lines, '\n' between them, without their indentation
        std::string after;  // on the entry's own line
    };
    std::unordered_map<std::uint32_t, Comments> comments;
    std::unordered_map<std::uint32_t, std::string> closingComments; // by section index

    // Look-ups by name in a section with many entries (a list of thousands of items) go
    // through an index made on first use, so that reading every item stays linear.
    struct LookupIndex {
        std::uint32_t firstEntry = 0;
        std::uint32_t entryCount = 0;
        std::unordered_map<std::int64_t, std::vector<std::uint32_t>> sections;  // table indices
        std::unordered_map<std::int64_t, std::vector<std::uint32_t>> keywords;
    };
    mutable std::unordered_map<std::uint32_t, LookupIndex> lookupIndexes;
    static constexpr std::uint32_t kIndexedEntries = 64;
    const LookupIndex& IndexOf(std::uint32_t sectionIndex, std::uint32_t firstEntry,
                               std::uint32_t entryCount) const;
    // The table index of the n-th subsection (or keyword) of that name in a section, or -1.
    std::int64_t FindEntry(std::uint32_t sectionIndex, std::uint32_t firstEntry,
                           std::uint32_t entryCount, std::string_view name, int n,
                           bool wantSection) const;

    std::size_t MemoryBytes() const;
};

// Private access for the free functions of the library.
struct Access {
    static const Document::Impl& Of(const Section& s) { return s.doc_->impl(); }
    // Null for the placeholder handed out for an index out of range.
    static const Document* DocOf(const Section& s) { return s.doc_; }
    static const Document::Impl& Of(const Keyword& k) { return k.doc_->impl(); }
    static const Document* DocOf(const Keyword& k) { return k.doc_; }

    static Param Int(std::int64_t v) {
        Param p;
        p.type_ = ParamType::Integer;
        p.bits_ = static_cast<std::uint64_t>(v);
        return p;
    }
    static Param Double(double v) {
        Param p;
        p.type_ = ParamType::Double;
        std::memcpy(&p.bits_, &v, sizeof v);
        return p;
    }
    static Param Float(float v) {
        Param p;
        p.type_ = ParamType::Float;
        std::uint32_t b;
        std::memcpy(&b, &v, sizeof v);
        p.bits_ = b;
        return p;
    }
    static Param Bool(bool v) {
        Param p;
        p.type_ = ParamType::Boolean;
        p.bits_ = v ? 1 : 0;
        return p;
    }
    static Param Text(ParamType type, const char* data, std::size_t n) {
        Param p;
        p.type_ = type;
        p.bits_ = reinterpret_cast<std::uintptr_t>(data);
        p.aux_ = static_cast<std::uint32_t>(n);
        return p;
    }
    static void SetFloat(Param& p, float f) {
        std::memcpy(&p.aux_, &f, sizeof f);
        p.flags_ |= kHasFloat;
    }
    static std::int64_t IntOf(const Param& p) { return static_cast<std::int64_t>(p.bits_); }
    static double DoubleOf(const Param& p) {
        double d;
        std::memcpy(&d, &p.bits_, sizeof d);
        return d;
    }
    static float FloatOf(const Param& p) {
        std::uint32_t b = static_cast<std::uint32_t>(p.bits_);
        float f;
        std::memcpy(&f, &b, sizeof f);
        return f;
    }
    static std::string_view TextOf(const Param& p) {
        return {reinterpret_cast<const char*>(static_cast<std::uintptr_t>(p.bits_)), p.aux_};
    }

    static Section MakeSection(const Document* doc, std::uint32_t name, Position pos) {
        Section s;
        s.doc_ = doc;
        s.name_ = name;
        s.pos_ = pos;
        return s;
    }
    static Keyword MakeKeyword(const Document* doc, std::uint32_t owner, std::uint32_t name,
                               std::uint32_t first, Position pos) {
        Keyword k;
        k.doc_ = doc;
        k.owner_ = owner;
        k.name_ = name;
        k.first_ = first;
        k.pos_ = pos;
        return k;
    }
    static std::uint32_t& FirstEntry(Section& s) { return s.firstEntry_; }
    static std::uint32_t& EntryCount(Section& s) { return s.entryCount_; }
    static std::uint32_t& ParamCount(Keyword& k) { return k.count_; }
    static std::uint32_t FirstParam(const Keyword& k) { return k.first_; }
    static std::uint32_t NameId(const Keyword& k) { return k.name_; }
    static std::uint32_t NameId(const Section& s) { return s.name_; }
    static std::uint32_t FirstEntry(const Section& s) { return s.firstEntry_; }
    static void SetColumn(Param& p, std::uint16_t column) { p.column_ = column; }
    static std::uint16_t ColumnOf(const Param& p) { return p.column_; }
    static std::uint32_t EntryCount(const Section& s) { return s.entryCount_; }
};

// Joins message parts by appending (g++ 12 warns falsely on "literal" + std::string).
inline void AppendPart(std::string& s, std::string_view v) {
    s.append(v);
}
inline void AppendPart(std::string& s, char c) {
    s += c;
}
template <class... Parts> std::string Cat(const Parts&... parts) {
    std::string s;
    (AppendPart(s, parts), ...);
    return s;
}

// Shortest text that reads back to the same value, always with '.' or an exponent.
// buf needs 32 bytes; returns the end.
char* FormatDouble(char* buf, double v);
char* FormatFloat(char* buf, float v);

// True when a double could round to a different float than the decimal text it came from.
bool MayMisroundAsFloat(double d);
// The float nearest to the decimal text [begin, end), whose value as a double is d.
float FloatOfText(const char* begin, const char* end, double d);

} // namespace paramfile
