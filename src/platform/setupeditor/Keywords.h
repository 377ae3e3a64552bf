// What describes a keyword for the reference: where it stands, its type, default, unit,
// allowed values and a line of text. Sections declare their keywords in plain tables of
// KeywordDecl (or in their KivField tables) and hand them to a KeywordSink when asked.
#pragma once

#include "common/Platform.h"

#include <string>
#include <vector>

enum class KeywordType {
    Int, Double, Float, Bool, Flag, String, FileName, ResultFileName, IntList, DoubleList,
    Values  // a list of mixed values, described in the text
};

const char* KeywordTypeName(KeywordType type);

struct KeywordDecl {
    const char* keyword;
    KeywordType type;
    const char* defaultValue;      // as a file holds it; "" where there is none
    const char* description;
    long unitType = 0;             // quantity code of the unit service, 0 for none
    const char* range = "";        // "> 0", "0 .. 1"
    const char* choices = "";      // "0 none, 1 constant"
    const char* section = "";      // below the node's own section ("LINE", "POINT_%d")
};

// One line of the reference, with the section path pattern written out.
struct KeywordEntry {
    std::string path;              // "MUD_TRANSPORT_MODULE/DREDGING/DREDGER_%d"
    std::string keyword;
    KeywordType type = KeywordType::Int;
    std::string defaultValue;
    long unitType = 0;
    std::string range;
    std::string choices;
    std::string description;

    std::string FullPath() const { return path + "/" + keyword; }
    // "m/s (Settling velocity)", or "" without a unit type.
    std::string UnitText() const;
};

// Collects declarations for the node being described. Path() is the section the node writes
// into (its own, or its parent's when it has none); Outer() the one its own section opens in.
class KeywordSink {
public:
    void Begin(std::string path, std::string outer) {
        m_path = std::move(path);
        m_outer = std::move(outer);
    }
    const std::string& Path() const { return m_path; }
    const std::string& Outer() const { return m_outer; }

    void Add(const KeywordDecl& decl) { AddAt(m_path, decl); }
    template <size_t N>
    void Add(const KeywordDecl (&decls)[N]) {
        for (const KeywordDecl& d : decls)
            Add(d);
    }
    // decl.section is taken below path.
    void AddAt(const std::string& path, const KeywordDecl& decl);
    void Add(KeywordEntry entry);

    // Every path and keyword once, the first declaration kept, in the order first declared.
    const std::vector<KeywordEntry>& Entries() const { return m_entries; }

private:
    std::string m_path;
    std::string m_outer;
    std::vector<KeywordEntry> m_entries;
};

// Text as a file holds it, for defaults declared from values.
std::string KeywordNumberText(double value);
std::string KeywordFloatText(float value);
std::string KeywordStringText(const std::string& value);
std::string KeywordFileNameText(const std::string& value);

// Section names written with their numbers, "DREDGER_12/POINT_3", with every number that
// stands between underscores or at the end turned back into "%d".
std::string KeywordPathPattern(const std::string& path);
