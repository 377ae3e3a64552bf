#include "Keywords.h"

#include "fem/UnitUtil.h"
#include "paramfile/ParamFileImpl.h"

#include <cctype>
#include <unordered_set>

const char* KeywordTypeName(KeywordType type) {
    switch (type) {
    case KeywordType::Int: return "int";
    case KeywordType::Double: return "double";
    case KeywordType::Float: return "float";
    case KeywordType::Bool: return "bool";
    case KeywordType::Flag: return "flag";
    case KeywordType::String: return "string";
    case KeywordType::FileName: return "filename";
    case KeywordType::ResultFileName: return "result filename";
    case KeywordType::IntList: return "int list";
    case KeywordType::DoubleList: return "double list";
    case KeywordType::Values: return "values";
    }
    return "";
}

std::string KeywordEntry::UnitText() const {
    const QuantityInfo* q = unitType ? CUnitUtil::FindQuantity(unitType) : nullptr;
    if (!q)
        return "";
    const CString unit = CUnitUtil::GetUnitName(CUnitUtil::GetFirstRegisteredUnit(unitType));
    return unit + " (" + q->name + ")";
}

void KeywordSink::AddAt(const std::string& path, const KeywordDecl& d) {
    KeywordEntry e;
    e.path = *d.section ? path + "/" + d.section : path;
    e.keyword = d.keyword;
    e.type = d.type;
    e.defaultValue = d.defaultValue;
    e.unitType = d.unitType;
    e.range = d.range;
    e.choices = d.choices;
    e.description = d.description;
    Add(std::move(e));
}

void KeywordSink::Add(KeywordEntry entry) {
    entry.path = KeywordPathPattern(entry.path);
    entry.keyword = KeywordPathPattern(entry.keyword);
    for (const KeywordEntry& e : m_entries)
        if (e.path == entry.path && e.keyword == entry.keyword)
            return;
    m_entries.push_back(std::move(entry));
}

std::string KeywordNumberText(double value) {
    char buf[32];
    return std::string(buf, paramfile::FormatDouble(buf, value));
}

std::string KeywordFloatText(float value) {
    char buf[32];
    return std::string(buf, paramfile::FormatFloat(buf, value));
}

std::string KeywordStringText(const std::string& value) {
    std::string s = "\"";
    for (char c : value) {
        switch (c) {
        case '"': s += "\\\""; break;
        case '\\': s += "\\\\"; break;
        case '\n': s += "\\n"; break;
        case '\t': s += "\\t"; break;
        case '\r': s += "\\r"; break;
        default: s += c;
        }
    }
    return s + "\"";
}

std::string KeywordFileNameText(const std::string& value) {
    std::string s = "'";
    for (char c : value) {
        s += c;
        if (c == '\'')
            s += '\'';
    }
    return s + "'";
}

std::string KeywordPathPattern(const std::string& path) {
    std::string out;
    out.reserve(path.size());
    for (size_t i = 0; i < path.size();) {
        const bool afterUnderscore = i > 0 && path[i - 1] == '_';
        if (afterUnderscore && std::isdigit(static_cast<unsigned char>(path[i]))) {
            size_t j = i;
            while (j < path.size() && std::isdigit(static_cast<unsigned char>(path[j])))
                ++j;
            if (j == path.size() || path[j] == '_' || path[j] == '/') {
                out += "%d";
                i = j;
                continue;
            }
        }
        out += path[i++];
    }
    return out;
}
