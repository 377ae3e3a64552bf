// Hierarchical parameter file: an in-memory document of nested sections holding keywords,
// each keyword with an ordered list of typed parameters; its reader and writer.
//
// Text syntax (UTF-8):
//   # comment to end of line (outside quotes)
//   NAME {                      section; names and keywords are [A-Za-z_][A-Za-z0-9_]*
//       keyword = v1, v2, ...   one line; no values is allowed
//   }
// Values: integer -?[0-9]+ | real (has '.' or exponent, or nan/inf/-inf) | true/false |
//         "string" with \" \\ \n \t \r escapes | 'file name' raw, '' for a quote.
// Every value written reads back unchanged: same type, same bits, same text.
#pragma once

#include "fileio/GuardedFile.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace paramfile {

enum class ParamType : std::uint8_t { Integer, Double, Float, Boolean, String, FileName };

// A position in the text, 1-based; 0 where a node was built in memory.
struct Position {
    int line = 0;
    int column = 0;
};

// A message tied to a place in a file: "FILE:LINE:COLUMN: message".
struct Diagnostic {
    std::string file;
    Position pos;
    std::string message;
    std::string ToString() const;
};

class Document;
class Section;

// One typed parameter. Readers convert where no information is lost and refuse otherwise:
// AsInt takes integers that fit 32 bits; AsDouble and AsFloat take reals and integers (a real
// read as float gives exactly the float whose shortest form was written); AsBool takes
// booleans and the integers 0 and 1; AsString takes strings and file names.
class Param {
public:
    ParamType Type() const;
    bool AsInt(std::int32_t& out) const;
    bool AsDouble(double& out) const;
    bool AsFloat(float& out) const;
    bool AsBool(bool& out) const;
    bool AsString(std::string& out) const;
    // A short description of the value's type for messages ("an integer", "a string", ...).
    const char* TypeName() const;

private:
    friend class Document;
    friend class Section;
    friend class Keyword;
    friend class Builder;
    friend struct Access;
    // Integer, double or float bits, 0/1, or a pointer to text held by the document.
    std::uint64_t bits_ = 0;
    // Text length; for a real read from text that a double would misround as float, the
    // float itself (flags_ says so).
    std::uint32_t aux_ = 0;
    ParamType type_ = ParamType::Integer;
    std::uint8_t flags_ = 0;
};

class Keyword {
public:
    std::string_view Name() const;
    int ParamCount() const;
    const Param& ParamAt(int index) const;  // 0-based, index < ParamCount()
    Position Pos() const;
    const Section& Owner() const;
    // True once a look-up by name (FindKeyword) has found this keyword.
    bool WasFound() const;

private:
    friend class Document;
    friend class Section;
    friend class Builder;
    friend struct Access;
    // Indices into the document's tables, so that the tables may grow while building.
    const Document* doc_ = nullptr;
    std::uint32_t owner_ = 0;
    std::uint32_t name_ = 0;
    std::uint32_t first_ = 0;
    std::uint32_t count_ = 0;
    Position pos_;
};

// A section: an ordered sequence of entries, each a keyword or a subsection.
class Section {
public:
    std::string_view Name() const;  // empty for the document's root
    Position Pos() const;
    const Document& Doc() const;

    int EntryCount() const;
    bool EntryIsSection(int index) const;
    const Keyword& KeywordAt(int index) const;   // EntryIsSection(index) false
    const Section& SectionAt(int index) const;   // EntryIsSection(index) true

    // The n-th occurrence (from 1) of a subsection or keyword of that name, or null. What
    // they find counts as read (WasFound).
    const Section* FindSection(std::string_view name, int n = 1) const;
    const Keyword* FindKeyword(std::string_view name, int n = 1) const;
    bool WasFound() const;

private:
    friend class Document;
    friend class Builder;
    friend struct Access;
    const Document* doc_ = nullptr;
    std::uint32_t name_ = 0;
    std::uint32_t firstEntry_ = 0;
    std::uint32_t entryCount_ = 0;
    Position pos_;
};

// Owns every section, keyword and parameter of one file. Reading a value of the wrong type
// is not an error of the file: the reader of the value adds a warning here and goes on.
class Document {
public:
    Document();
    ~Document();
    Document(const Document&) = delete;
    Document& operator=(const Document&) = delete;

    const std::string& FileName() const;
    void SetFileName(std::string name);

    // The unnamed root; its subsections are the file's top-level sections.
    const Section& Root() const;

    const std::vector<Diagnostic>& Warnings() const;
    void AddWarning(Position pos, std::string message) const;
    // Where the text read ended (its last line); line 0 for a document built in memory.
    Position End() const;

    struct Impl;
    Impl& impl() const { return *impl_; }

private:
    std::unique_ptr<Impl> impl_;
};

struct ParseResult {
    std::unique_ptr<Document> document;  // null when error is set
    std::optional<Diagnostic> error;
    // The error came before the first section opened: the text is not a parameter file.
    bool beforeFirstSection = false;
    fileio::FileIdentity identity;  // of the file read, to tell whether it changed since
};

// Every entry below section that no look-up found, one message each at its place ("unknown
// keyword 'x' in PATH"); the subsections found are searched in turn, the others reported
// whole. path names section in the messages. Linear in the entries.
std::vector<Diagnostic> UnreadEntries(const Section& section, const std::string& path);

// Checks the whole text first: on a syntax error nothing is returned but the error.
ParseResult ParseText(std::string text, std::string fileName);
// As ParseText; a file that cannot be read, or is not a regular file of at most
// kMaxFileBytes, gives an error at line 0, column 0 (nothing is read from it).
inline constexpr long long kMaxFileBytes = fileio::kSetupFiles.maxBytes;
ParseResult ParseFile(const std::string& path);

// The canonical text: four spaces a level, "keyword = v1, v2", reals in shortest form;
// comments on lines of their own before their entry, or after it on its line.
std::string WriteText(const Document& doc);
void WriteText(const Document& doc, std::string& out);

// Builds a document in order: sections opened and closed, keywords with their parameters.
class Builder {
public:
    explicit Builder(Document& doc);
    ~Builder();
    Builder(const Builder&) = delete;
    Builder& operator=(const Builder&) = delete;

    void BeginSection(std::string_view name);
    void EndSection();  // closes the innermost open section; ignored at the root
    void AddKeyword(std::string_view name);  // the parameters below go to this keyword
    void AddInt(std::int32_t v);
    void AddDouble(double v);
    void AddFloat(float v);
    void AddBool(bool v);
    void AddString(std::string_view v);
    void AddFileName(std::string_view v);
    // File names added from now on, copied ones too, are stored as map gives them (a setup
    // saved into another folder names the same files from there).
    void MapFileNames(std::function<std::string(std::string_view)> map);
    // Deep copy of a section of another (or this) document into the current section, with
    // its comments.
    void CopySection(const Section& section);
    // Sections and keywords built from now on take the comments of their namesakes at the
    // same place in source (which must outlive the builder).
    void TakeCommentsFrom(const Document& source);
    int Depth() const;  // open sections below the root

    struct State;

private:
    Document& doc_;
    std::unique_ptr<State> state_;
};

}  // namespace paramfile
