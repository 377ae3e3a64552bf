#include "paramfile/Kiv.h"

#include "paramfile/ParamFileImpl.h"

#include <algorithm>
#include <climits>
#include <cstdarg>
#include <cstring>

using paramfile::Access;
using paramfile::Builder;
using paramfile::Keyword;
using paramfile::Param;
using paramfile::ParamType;
using paramfile::Section;

namespace {

Builder* Out(void* h) {
    return static_cast<Builder*>(h);
}
const Section* In(void* h) {
    return static_cast<const Section*>(h);
}
std::string_view Text(const char* s) {
    return s ? std::string_view(s) : std::string_view();
}

struct Found {
    const Keyword* keyword = nullptr;
    const Param* param = nullptr;
    int index = 0;
};

// Values 1 .. n of k count as read: those past them are reported as unread content.
void MarkRead(const Keyword* k, int n) {
    if (!k || !Access::DocOf(*k) || n < 1)
        return;
    const auto& d = Access::Of(*k);
    d.MarkValuesRead(static_cast<std::uint32_t>(k - d.keywords.data()),
                     static_cast<std::uint32_t>(std::min(n, k->ParamCount())));
}

// The keyword is set whenever it was found, the parameter only when it has that value.
Found Lookup(void* h, const char* keyword, int occurrence, int index) {
    if (!h || !keyword)
        return {};
    const Keyword* k = In(h)->FindKeyword(keyword, occurrence);
    if (!k || index < 1 || index > k->ParamCount())
        return {k, nullptr, index};
    MarkRead(k, index);
    return {k, &k->ParamAt(index - 1), index};
}

std::string Subject(const Found& f) {
    std::string s = paramfile::Cat("'", f.keyword->Name(), "'");
    if (f.index > 1)
        s += paramfile::Cat(" value ", std::to_string(f.index));
    return s;
}

void Warn(const Found& f, const std::string& message) {
    f.keyword->Owner().Doc().AddWarning(f.keyword->Pos(), message);
}

void WarnType(const Found& f, const char* expected) {
    Warn(f, paramfile::Cat(Subject(f), " expects ", expected, ", found ", f.param->TypeName()));
}

std::string ValueText(const Param& p) {
    char buf[40];
    char* e = buf;
    switch (p.Type()) {
    case ParamType::Integer:
        return std::to_string(Access::IntOf(p));
    case ParamType::Double:
        e = paramfile::FormatDouble(buf, Access::DoubleOf(p));
        break;
    case ParamType::Float:
        e = paramfile::FormatFloat(buf, Access::FloatOf(p));
        break;
    default:
        break;
    }
    return std::string(buf, e);
}

// For values of the right kind that the target cannot hold: the value says more than its type.
std::string AboutValue(const Found& f, const char* what) {
    return paramfile::Cat("'", f.keyword->Name(), "' value ", ValueText(*f.param), what);
}

void Read(const Found& f, int* value) {
    std::int32_t v;
    if (f.param->AsInt(v))
        *value = v;
    else if (f.param->Type() == ParamType::Integer)
        Warn(f, AboutValue(f, " is out of range for an integer"));
    else
        WarnType(f, "an integer");
}

void Read(const Found& f, double* value) {
    if (f.param->AsDouble(*value))
        return;
    if (f.param->Type() == ParamType::Integer)
        Warn(f, AboutValue(f, " cannot be held exactly by a real number"));
    else
        WarnType(f, "a number");
}

void Read(const Found& f, float* value) {
    if (f.param->AsFloat(*value))
        return;
    if (f.param->Type() == ParamType::Integer)
        Warn(f, AboutValue(f, " cannot be held exactly by a float"));
    else if (f.param->Type() == ParamType::Double)
        Warn(f, AboutValue(f, " is out of range for a float"));
    else
        WarnType(f, "a number");
}

void Read(const Found& f, bool* value) {
    if (!f.param->AsBool(*value))
        WarnType(f, "a boolean");
}

void Read(const Found& f, std::string* value) {
    if (!f.param->AsString(*value))
        WarnType(f, "a string");
}

void ReadFileName(const Found& f, std::string* value) {
    if (!f.param->AsString(*value))
        WarnType(f, "a file name");
}

std::string KeptText(const int* v) {
    return std::to_string(*v);
}
std::string KeptText(const double* v) {
    return ValueText(Access::Double(*v));
}
std::string KeptText(const float* v) {
    return ValueText(Access::Float(*v));
}
std::string KeptText(const bool* v) {
    return *v ? "true" : "false";
}
std::string KeptText(const std::string* v) {
    return paramfile::Cat("\"", *v, "\"");
}

// "count =" where a value is read: the target keeps what it holds, which is said.
bool HasNoValue(const Found& f) {
    return f.keyword && f.keyword->ParamCount() == 0;
}
void WarnNoValue(const Found& f, const std::string& kept) {
    Warn(f, paramfile::Cat("'", f.keyword->Name(), "' has no value; kept ", kept));
}

template <class T> void Get(void* h, const char* keyword, T* value, int occurrence, int index) {
    if (!value)
        return;
    const Found f = Lookup(h, keyword, occurrence, index);
    if (f.param)
        Read(f, value);
    else if (HasNoValue(f))
        WarnNoValue(f, KeptText(value));
}

} // namespace

// --- writing -----------------------------------------------------------------------------

void kivAddSection(void* h, const char* name) {
    if (h)
        Out(h)->BeginSection(Text(name));
}

void kivEndSection(void* h) {
    if (h)
        Out(h)->EndSection();
}

void kivAddKeyword(void* h, const char* keyword) {
    if (h)
        Out(h)->AddKeyword(Text(keyword));
}

void kivAddInt(void* h, int value) {
    if (h)
        Out(h)->AddInt(value);
}

void kivAddDouble(void* h, double value) {
    if (h)
        Out(h)->AddDouble(value);
}

void kivAddFloat(void* h, float value) {
    if (h)
        Out(h)->AddFloat(value);
}

void kivAddString(void* h, const std::string& value) {
    if (h)
        Out(h)->AddString(value);
}

void kivAddFilename(void* h, const std::string& path) {
    if (h)
        Out(h)->AddFileName(path);
}

void kivAddResultFilename(void* h, const std::string& path) {
    kivAddFilename(h, path);
}

void kivPutParam(void* h, const char* keyword, int value) {
    kivAddKeyword(h, keyword);
    kivAddInt(h, value);
}

void kivPutParam(void* h, const char* keyword, double value) {
    kivAddKeyword(h, keyword);
    kivAddDouble(h, value);
}

void kivPutParam(void* h, const char* keyword, float value) {
    kivAddKeyword(h, keyword);
    kivAddFloat(h, value);
}

void kivPutParam(void* h, const char* keyword, bool value) {
    kivAddKeyword(h, keyword);
    if (h)
        Out(h)->AddBool(value);
}

void kivPutParam(void* h, const char* keyword, const std::string& value) {
    kivAddKeyword(h, keyword);
    kivAddString(h, value);
}

void kivPutParam(void* h, const char* keyword, const char* value) {
    kivAddKeyword(h, keyword);
    if (h)
        Out(h)->AddString(Text(value));
}

void kivPutParamFilename(void* h, const char* keyword, const std::string& path) {
    kivAddKeyword(h, keyword);
    kivAddFilename(h, path);
}

void kivPutListParam(void* h, const char* keyword, const char* format, ...) {
    if (!h || !format)
        return;
    Builder& b = *Out(h);
    b.AddKeyword(Text(keyword));
    va_list args;
    va_start(args, format);
    for (const char* f = format; *f; ++f) {
        switch (*f) {
        case 'i':
            b.AddInt(va_arg(args, int));
            continue;
        case 'd':
            b.AddDouble(va_arg(args, double));
            continue;
        case 'f':
            b.AddFloat(static_cast<float>(va_arg(args, double)));
            continue;
        case 'b':
            b.AddBool(va_arg(args, int) != 0);
            continue;
        case 's':
            b.AddString(Text(va_arg(args, const char*)));
            continue;
        case 'F':
            b.AddFileName(Text(va_arg(args, const char*)));
            continue;
        default:
            break; // an unknown letter leaves the argument types unknown: stop
        }
        break;
    }
    va_end(args);
}

// --- reading -----------------------------------------------------------------------------

void* kivSectionByNameNum(void* h, const char* name, int n) {
    if (!h || !name)
        return nullptr;
    return const_cast<Section*>(In(h)->FindSection(name, n));
}

void* kivKeywordByNameNum(void* h, const char* keyword, int n) {
    if (!h || !keyword)
        return nullptr;
    return const_cast<Keyword*>(In(h)->FindKeyword(keyword, n));
}

int kivParamCount(void* k) {
    return k ? static_cast<const Keyword*>(k)->ParamCount() : 0;
}

void* kivParamByNum(void* k, int n) {
    const auto* kw = static_cast<const Keyword*>(k);
    if (!kw || n < 1 || n > kw->ParamCount())
        return nullptr;
    MarkRead(kw, n);
    return const_cast<Param*>(&kw->ParamAt(n - 1));
}

double kivGetDouble(void* p) {
    double v = 0;
    if (!p || !static_cast<const Param*>(p)->AsDouble(v))
        return 0;
    return v;
}

int kivGetInt(void* p) {
    std::int32_t v = 0;
    if (!p || !static_cast<const Param*>(p)->AsInt(v))
        return 0;
    return v;
}

std::string kivGetResultFilename(void* p) {
    std::string s;
    if (p)
        static_cast<const Param*>(p)->AsString(s);
    return s;
}

void kivGetParam(void* h, const char* keyword, int* value, int occurrence, int index) {
    Get(h, keyword, value, occurrence, index);
}

void kivGetParam(void* h, const char* keyword, double* value, int occurrence, int index) {
    Get(h, keyword, value, occurrence, index);
}

void kivGetParam(void* h, const char* keyword, float* value, int occurrence, int index) {
    Get(h, keyword, value, occurrence, index);
}

void kivGetParam(void* h, const char* keyword, bool* value, int occurrence, int index) {
    Get(h, keyword, value, occurrence, index);
}

void kivGetParam(void* h, const char* keyword, std::string* value, int occurrence, int index) {
    Get(h, keyword, value, occurrence, index);
}

void kivGetParamFilename(void* h, const char* keyword, std::string* value, int occurrence,
                         int index) {
    if (!value)
        return;
    const Found f = Lookup(h, keyword, occurrence, index);
    if (f.param)
        ReadFileName(f, value);
    else if (HasNoValue(f))
        WarnNoValue(f, paramfile::Cat("'", *value, "'"));
}

void kivGetListParam(void* h, const char* keyword, int occurrence, const char* format, ...) {
    if (!h || !keyword || !format)
        return;
    const Keyword* k = In(h)->FindKeyword(keyword, occurrence);
    if (!k)
        return;
    MarkRead(k, static_cast<int>(std::min<std::size_t>(std::strlen(format), INT_MAX)));
    va_list args;
    va_start(args, format);
    int index = 0;
    for (const char* f = format; *f; ++f) {
        ++index;
        Found found;
        if (index <= k->ParamCount())
            found = Found{k, &k->ParamAt(index - 1), index};
        auto read = [&](auto* target) {
            if (found.param && target)
                Read(found, target);
        };
        switch (*f) {
        case 'i':
            read(va_arg(args, int*));
            continue;
        case 'd':
            read(va_arg(args, double*));
            continue;
        case 'f':
            read(va_arg(args, float*));
            continue;
        case 'b':
            read(va_arg(args, bool*));
            continue;
        case 's':
            read(va_arg(args, std::string*));
            continue;
        case 'F': {
            std::string* target = va_arg(args, std::string*);
            if (found.param && target)
                ReadFileName(found, target);
            continue;
        }
        default:
            break;
        }
        break;
    }
    va_end(args);
}

void kivWarn(void* h, const char* keyword, const std::string& message) {
    if (!h || !Access::DocOf(*In(h)))
        return;
    const Section* s = In(h);
    const Keyword* k = keyword ? s->FindKeyword(keyword) : nullptr;
    s->Doc().AddWarning(k ? k->Pos() : s->Pos(), message);
}
