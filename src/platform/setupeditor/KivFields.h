// A section's plain keywords declared once, in file order, with their defaults: the table
// drives writing, reading and resetting, so the three can never disagree.
//
//   static const KivField<CMyKiv> kFields[] = {
//       KivField<CMyKiv>::Int("flocculation_description", &CMyKiv::m_floc, 1),
//       KivField<CMyKiv>::Double("rho_sediment", &CMyKiv::m_rho, 2650.0),
//   };
//   WriteFields(h, *this, kFields); ReadFields(h, *this, kFields); DefaultFields(*this, kFields);
//
// The same table describes the keywords for the reference (DescribeFields): add the unit,
// the range or choices and a line of text where the field is declared,
//       F::Double("rho_sediment", &K::m_rho, 2650.0).Unit(100012).Range("> 0").Doc("...")
#pragma once

#include "common/Platform.h"
#include "paramfile/Kiv.h"
#include "setupeditor/Keywords.h"

#include <cmath>
#include <cstddef>
#include <limits>

// A double narrowed for a float keyword; beyond the float range it becomes an infinity
// rather than undefined behaviour.
inline float ToFileFloat(double v) {
    constexpr double kMax = std::numeric_limits<float>::max();
    if (v > kMax)
        return std::numeric_limits<float>::infinity();
    if (v < -kMax)
        return -std::numeric_limits<float>::infinity();
    return static_cast<float>(v);
}

// Reads a double that the file holds as a float. A finite value beyond the float range
// would be saved as an infinity, so it is refused with a warning and the value kept;
// nan and inf read literally stay as they are.
inline void ReadFileFloat(void* h, const char* keyword, double* value) {
    double v = *value;
    kivGetParam(h, keyword, &v, 1, 1);
    if (std::isfinite(v) && std::fabs(v) > std::numeric_limits<float>::max()) {
        kivWarn(h, keyword,
                FormatString("'%s' value %g is out of range for a float; kept %g", keyword, v,
                             *value));
        return;
    }
    *value = v;
}

template <class O>
struct KivField {
    enum class Kind { Int, Double, Float, DoubleAsFloat, Bool, Flag, String, FileName };

    const char* keyword;
    Kind kind;
    int O::*intMember = nullptr;
    double O::*doubleMember = nullptr;
    float O::*floatMember = nullptr;
    bool O::*boolMember = nullptr;
    CString O::*stringMember = nullptr;
    double numericDefault = 0.0;
    const char* stringDefault = "";
    long unitType = 0;
    const char* range = "";
    const char* choices = "";
    const char* description = "";

    KivField Unit(long type) const {
        KivField f = *this;
        f.unitType = type;
        return f;
    }
    KivField Range(const char* text) const {
        KivField f = *this;
        f.range = text;
        return f;
    }
    KivField Choices(const char* text) const {
        KivField f = *this;
        f.choices = text;
        return f;
    }
    KivField Doc(const char* text) const {
        KivField f = *this;
        f.description = text;
        return f;
    }

    static KivField Int(const char* kw, int O::*m, int def) {
        KivField f{kw, Kind::Int};
        f.intMember = m;
        f.numericDefault = def;
        return f;
    }
    static KivField Double(const char* kw, double O::*m, double def) {
        KivField f{kw, Kind::Double};
        f.doubleMember = m;
        f.numericDefault = def;
        return f;
    }
    static KivField Float(const char* kw, float O::*m, float def) {
        KivField f{kw, Kind::Float};
        f.floatMember = m;
        f.numericDefault = def;
        return f;
    }
    // A double held in the model, written as a float: the file keeps the float type, and
    // the model never narrows what it reads or what the user typed.
    static KivField DoubleAsFloat(const char* kw, double O::*m, double def) {
        KivField f{kw, Kind::DoubleAsFloat};
        f.doubleMember = m;
        f.numericDefault = def;
        return f;
    }
    // true / false in the file.
    static KivField Bool(const char* kw, bool O::*m, bool def) {
        KivField f{kw, Kind::Bool};
        f.boolMember = m;
        f.numericDefault = def ? 1 : 0;
        return f;
    }
    // An integer 1 or 0 in the file, read as true exactly when it is 1.
    static KivField Flag(const char* kw, bool O::*m, bool def) {
        KivField f{kw, Kind::Flag};
        f.boolMember = m;
        f.numericDefault = def ? 1 : 0;
        return f;
    }
    static KivField String(const char* kw, CString O::*m, const char* def) {
        KivField f{kw, Kind::String};
        f.stringMember = m;
        f.stringDefault = def;
        return f;
    }
    static KivField FileName(const char* kw, CString O::*m, const char* def) {
        KivField f{kw, Kind::FileName};
        f.stringMember = m;
        f.stringDefault = def;
        return f;
    }
};

template <class O, size_t N>
void WriteFields(void* h, const O& o, const KivField<O> (&fields)[N]) {
    using K = typename KivField<O>::Kind;
    for (const KivField<O>& f : fields) {
        switch (f.kind) {
        case K::Int: kivPutParam(h, f.keyword, o.*f.intMember); break;
        case K::Double: kivPutParam(h, f.keyword, o.*f.doubleMember); break;
        case K::Float: kivPutParam(h, f.keyword, o.*f.floatMember); break;
        case K::DoubleAsFloat:
            kivPutParam(h, f.keyword, ToFileFloat(o.*f.doubleMember));
            break;
        case K::Bool: kivPutParam(h, f.keyword, o.*f.boolMember); break;
        case K::Flag: kivPutParam(h, f.keyword, (o.*f.boolMember) ? 1 : 0); break;
        case K::String: kivPutParam(h, f.keyword, o.*f.stringMember); break;
        case K::FileName: kivPutParamFilename(h, f.keyword, o.*f.stringMember); break;
        }
    }
}

// A missing keyword keeps the value the field holds.
template <class O, size_t N>
void ReadFields(void* h, O& o, const KivField<O> (&fields)[N]) {
    using K = typename KivField<O>::Kind;
    for (const KivField<O>& f : fields) {
        switch (f.kind) {
        case K::Int: kivGetParam(h, f.keyword, &(o.*f.intMember), 1, 1); break;
        case K::Double: kivGetParam(h, f.keyword, &(o.*f.doubleMember), 1, 1); break;
        case K::DoubleAsFloat: ReadFileFloat(h, f.keyword, &(o.*f.doubleMember)); break;
        case K::Float: kivGetParam(h, f.keyword, &(o.*f.floatMember), 1, 1); break;
        case K::Bool: kivGetParam(h, f.keyword, &(o.*f.boolMember), 1, 1); break;
        case K::Flag: {
            int v = (o.*f.boolMember) ? 1 : 0;
            kivGetParam(h, f.keyword, &v, 1, 1);
            o.*f.boolMember = (v == 1);
            break;
        }
        case K::String: kivGetParam(h, f.keyword, &(o.*f.stringMember), 1, 1); break;
        case K::FileName: kivGetParamFilename(h, f.keyword, &(o.*f.stringMember), 1, 1); break;
        }
    }
}

template <class O, size_t N>
void DefaultFields(O& o, const KivField<O> (&fields)[N]) {
    using K = typename KivField<O>::Kind;
    for (const KivField<O>& f : fields) {
        switch (f.kind) {
        case K::Int: o.*f.intMember = static_cast<int>(f.numericDefault); break;
        case K::Double:
        case K::DoubleAsFloat: o.*f.doubleMember = f.numericDefault; break;
        case K::Float: o.*f.floatMember = static_cast<float>(f.numericDefault); break;
        case K::Bool:
        case K::Flag: o.*f.boolMember = f.numericDefault != 0; break;
        case K::String:
        case K::FileName: o.*f.stringMember = f.stringDefault; break;
        }
    }
}

template <class O, size_t N>
void DescribeFields(KeywordSink& sink, const KivField<O> (&fields)[N]) {
    using K = typename KivField<O>::Kind;
    for (const KivField<O>& f : fields) {
        KeywordEntry e;
        e.path = sink.Path();
        e.keyword = f.keyword;
        switch (f.kind) {
        case K::Int:
            e.type = KeywordType::Int;
            e.defaultValue = std::to_string(static_cast<int>(f.numericDefault));
            break;
        case K::Double:
            e.type = KeywordType::Double;
            e.defaultValue = KeywordNumberText(f.numericDefault);
            break;
        case K::Float:
        case K::DoubleAsFloat:
            e.type = KeywordType::Float;
            e.defaultValue = KeywordFloatText(ToFileFloat(f.numericDefault));
            break;
        case K::Bool:
            e.type = KeywordType::Bool;
            e.defaultValue = f.numericDefault != 0 ? "true" : "false";
            break;
        case K::Flag:
            e.type = KeywordType::Flag;
            e.defaultValue = f.numericDefault != 0 ? "1" : "0";
            break;
        case K::String:
            e.type = KeywordType::String;
            e.defaultValue = KeywordStringText(f.stringDefault);
            break;
        case K::FileName:
            e.type = KeywordType::FileName;
            e.defaultValue = KeywordFileNameText(f.stringDefault);
            break;
        }
        e.unitType = f.unitType;
        e.range = f.range;
        e.choices = f.choices;
        e.description = f.description;
        sink.Add(std::move(e));
    }
}
