#include "DataFile.h"

#include "fem/UnitUtil.h"
#include "fileio/GuardedFile.h"

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <functional>
#include <limits>
#include <memory>

namespace datafile {

namespace {

bool EqualsNoCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size())
        return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if (std::tolower(static_cast<unsigned char>(a[i])) !=
            std::tolower(static_cast<unsigned char>(b[i])))
            return false;
    return true;
}

std::string Quote(std::string_view s) {
    std::string out = "\"";
    for (char c : s) {
        if (c == '"' || c == '\\')
            out += '\\';
        if (c == '\n') {
            out += "\\n";
            continue;
        }
        out += c;
    }
    return out + '"';
}

std::string FormatNumber(double v) {
    if (std::isnan(v))
        return "nan";
    if (std::isinf(v))
        return v > 0 ? "inf" : "-inf";
    char buf[64];
    const auto r = std::to_chars(buf, buf + sizeof buf, v);
    return std::string(buf, r.ptr);
}

// Characters from a buffer or a file, with the line and column of the next one. Files are
// read in blocks, so that the header of a large file costs one block.
class Source {
public:
    explicit Source(std::string_view text) : m_data(text.data()), m_end(text.size()) {}
    explicit Source(fileio::InFile& file) : m_file(&file), m_block(1 << 16) {}

    int Get() {
        if (m_pos == m_end && !Refill())
            return EOF;
        const char c = m_data[m_pos++];
        ++m_consumed;
        if (c == '\n') {
            ++m_line;
            m_column = 1;
        } else {
            ++m_column;
        }
        return static_cast<unsigned char>(c);
    }
    int Peek() {
        if (m_pos == m_end && !Refill())
            return EOF;
        return static_cast<unsigned char>(m_data[m_pos]);
    }
    int Line() const { return m_line; }
    int Column() const { return m_column; }
    std::size_t Consumed() const { return m_consumed; }
    bool ReadFailed() const { return m_failed; }

private:
    bool Refill() {
        if (!m_file)
            return false;
        const std::ptrdiff_t n = m_file->Read(m_block.data(), m_block.size());
        if (n <= 0) {
            m_failed = n < 0;
            return false;
        }
        m_data = m_block.data();
        m_pos = 0;
        m_end = static_cast<std::size_t>(n);
        return true;
    }

    fileio::InFile* m_file = nullptr;
    std::vector<char> m_block;
    const char* m_data = nullptr;
    std::size_t m_pos = 0, m_end = 0;
    std::size_t m_consumed = 0;
    int m_line = 1, m_column = 1;
    bool m_failed = false;
};

struct Token {
    std::string text;
    int column = 0;
    bool quoted = false;
};

class HeaderParser {
public:
    HeaderParser(Source& src, const std::string& name) : m_src(src), m_name(name) {}

    HeaderResult Run();

private:
    Error Fail(int line, int column, std::string message) const {
        return Error{m_name, line, column, std::move(message)};
    }
    // One line into tokens; false at the end of the input (nothing read).
    bool NextLine(std::vector<Token>& tokens, std::optional<Error>& error);
    std::optional<Error> Keyword(const std::vector<Token>& t);
    std::optional<Error> Finish();

    std::optional<Error> Int(const Token& t, std::int64_t lo, std::int64_t hi, std::int64_t& out,
                             const char* what) const;
    std::optional<Error> Real(const Token& t, double& out, const char* what) const;
    std::optional<Error> Count(const std::vector<Token>& t, std::size_t n, const char* usage) const;

    Source& m_src;
    const std::string& m_name;
    Header m_h;
    int m_line = 0;
    bool m_haveKind = false;
    bool m_sawValues = false;
    // First line of each keyword that may appear once.
    std::vector<std::pair<std::string, int>> m_seen;
    std::int64_t m_declaredItems = -1;
    int m_itemsLine = 0;
};

bool HeaderParser::NextLine(std::vector<Token>& tokens, std::optional<Error>& error) {
    tokens.clear();
    if (m_src.Peek() == EOF)
        return false;
    m_line = m_src.Line();
    std::string line;
    for (int c = m_src.Get(); c != EOF && c != '\n'; c = m_src.Get()) {
        if (line.size() >= kMaxHeaderLine) {
            error = Fail(m_line, static_cast<int>(line.size()) + 1,
                         "a header line is longer than " + std::to_string(kMaxHeaderLine) +
                             " characters");
            return true;
        }
        line += static_cast<char>(c);
    }
    if (m_src.Consumed() > kMaxHeaderBytes) {
        error = Fail(m_line, 1,
                     "the header is longer than " + std::to_string(kMaxHeaderBytes >> 20) +
                         " MiB without a \"values\" line");
        return true;
    }
    if (!line.empty() && line.back() == '\r')
        line.pop_back();
    std::size_t i = 0;
    while (i < line.size()) {
        const char c = line[i];
        if (c == ' ' || c == '\t') {
            ++i;
            continue;
        }
        if (c == '#')
            break;
        Token t;
        t.column = static_cast<int>(i) + 1;
        if (c == '"') {
            t.quoted = true;
            ++i;
            bool closed = false;
            while (i < line.size()) {
                char d = line[i++];
                if (d == '"') {
                    closed = true;
                    break;
                }
                if (d == '\\' && i < line.size()) {
                    d = line[i++];
                    if (d == 'n')
                        d = '\n';
                    else if (d == 't')
                        d = '\t';
                }
                t.text += d;
            }
            if (!closed) {
                error = Fail(m_line, t.column, "a quoted text is not closed");
                return true;
            }
        } else {
            while (i < line.size() && line[i] != ' ' && line[i] != '\t' && line[i] != '#')
                t.text += line[i++];
        }
        tokens.push_back(std::move(t));
    }
    return true;
}

std::optional<Error> HeaderParser::Int(const Token& t, std::int64_t lo, std::int64_t hi,
                                       std::int64_t& out, const char* what) const {
    std::int64_t v = 0;
    const char* b = t.text.data();
    const char* e = b + t.text.size();
    const auto r = std::from_chars(b, e, v);
    if (t.quoted || r.ec == std::errc::invalid_argument || r.ptr != e)
        return Fail(m_line, t.column, std::string(what) + " must be a whole number, not \"" +
                                          t.text + "\"");
    if (r.ec == std::errc::result_out_of_range || v < lo || v > hi)
        return Fail(m_line, t.column,
                    std::string(what) + " must lie between " + std::to_string(lo) + " and " +
                        std::to_string(hi) + ", not " + t.text);
    out = v;
    return std::nullopt;
}

std::optional<Error> HeaderParser::Real(const Token& t, double& out, const char* what) const {
    double v = 0;
    std::string_view s = t.text;
    if (!s.empty() && s[0] == '+')
        s.remove_prefix(1);
    const auto r = std::from_chars(s.data(), s.data() + s.size(), v);
    if (t.quoted || s.empty() || r.ec != std::errc() || r.ptr != s.data() + s.size() ||
        !std::isfinite(v))
        return Fail(m_line, t.column,
                    std::string(what) + " must be a finite number, not \"" + t.text + "\"");
    out = v;
    return std::nullopt;
}

std::optional<Error> HeaderParser::Count(const std::vector<Token>& t, std::size_t n,
                                         const char* usage) const {
    if (t.size() == n)
        return std::nullopt;
    const int column = t.size() > n ? t[n].column : t.back().column +
                                                        static_cast<int>(t.back().text.size());
    return Fail(m_line, column, std::string("expected \"") + usage + "\"");
}

std::optional<Error> HeaderParser::Keyword(const std::vector<Token>& t) {
    const std::string& kw = t[0].text;
    const Kind kind = m_h.kind;
    auto once = [&]() -> std::optional<Error> {
        for (const auto& [name, line] : m_seen)
            if (name == kw)
                return Fail(m_line, t[0].column,
                            "\"" + kw + "\" is given twice (first on line " +
                                std::to_string(line) + ")");
        m_seen.emplace_back(kw, m_line);
        return std::nullopt;
    };
    auto onlyFor = [&](Kind k) -> std::optional<Error> {
        if (kind == k)
            return std::nullopt;
        return Fail(m_line, t[0].column,
                    "\"" + kw + "\" belongs to a " + KindName(k) + " file, not to a " +
                        KindName(kind) + " file");
    };
    std::optional<Error> e;
    if (kw == "title") {
        if ((e = once()) || (e = Count(t, 2, "title \"TEXT\"")))
            return e;
        m_h.title = t[1].text;
    } else if (kw == "start") {
        if ((e = once()))
            return e;
        if (t.size() < 2 || t.size() > 3)
            return Count(t, 2, "start yyyy-MM-dd HH:mm:ss");
        std::string text = t[1].text;
        if (t.size() == 3)
            text += " " + t[2].text;
        const auto s = ParseDateTime(text);
        if (!s)
            return Fail(m_line, t[1].column,
                        "the start must be a date and time (yyyy-MM-dd HH:mm:ss), not \"" + text +
                            "\"");
        m_h.time.start = *s;
    } else if (kw == "step") {
        if ((e = once()) || (e = Count(t, 2, "step SECONDS")) ||
            (e = Real(t[1], m_h.time.step, "the time step")))
            return e;
        if (!(m_h.time.step > 0))
            return Fail(m_line, t[1].column, "the time step must be more than 0 seconds");
    } else if (kw == "steps") {
        if ((e = once()) || (e = Count(t, 2, "steps N")) ||
            (e = Int(t[1], 1, kMaxSteps, m_h.time.steps, "the number of time steps")))
            return e;
    } else if (kw == "items") {
        if ((e = once()) || (e = Count(t, 2, "items N")) ||
            (e = Int(t[1], 1, kMaxItems, m_declaredItems, "the number of items")))
            return e;
        m_itemsLine = m_line;
        if (static_cast<std::int64_t>(m_h.items.size()) > m_declaredItems)
            return Fail(m_line, t[1].column,
                        "\"items\" says " + t[1].text + " but " +
                            std::to_string(m_h.items.size()) + " item lines come before it");
    } else if (kw == "item") {
        if (t.size() < 3 || t.size() > 4)
            return Count(t, 3, "item NAME UNITTYPE [UNIT]");
        if (m_declaredItems >= 0 && static_cast<std::int64_t>(m_h.items.size()) >= m_declaredItems)
            return Fail(m_line, t[0].column,
                        "more item lines than \"items\" on line " + std::to_string(m_itemsLine) +
                            " announces (" + std::to_string(m_declaredItems) + ")");
        if (m_h.items.size() >= static_cast<std::size_t>(kMaxItems))
            return Fail(m_line, t[0].column,
                        "more than " + std::to_string(kMaxItems) + " items");
        Item item;
        item.name = t[1].text;
        if (item.name.empty())
            return Fail(m_line, t[1].column, "an item needs a name");
        const QuantityInfo* q = nullptr;
        long code = 0;
        const auto r = std::from_chars(t[2].text.data(), t[2].text.data() + t[2].text.size(), code);
        if (!t[2].quoted && r.ec == std::errc() && r.ptr == t[2].text.data() + t[2].text.size()) {
            q = CUnitUtil::FindQuantity(code);
        } else {
            for (const QuantityInfo& info : CUnitUtil::Quantities())
                if (EqualsNoCase(info.name, t[2].text))
                    q = &info;
        }
        if (!q)
            return Fail(m_line, t[2].column,
                        "unknown unit type \"" + t[2].text + "\" (see docs/data-files.md)");
        item.unitType = q->code;
        item.unit = q->units.front().name;
        if (t.size() == 4) {
            const auto u = std::find_if(q->units.begin(), q->units.end(), [&](const UnitInfo& ui) {
                return t[3].text == ui.name;
            });
            if (u == q->units.end()) {
                std::string known;
                for (const UnitInfo& ui : q->units)
                    known += (known.empty() ? "" : ", ") + std::string(ui.name);
                return Fail(m_line, t[3].column,
                            "\"" + t[3].text + "\" is not a unit of " + q->name + " (" + known +
                                ")");
            }
            item.unit = u->name;
        }
        m_h.items.push_back(std::move(item));
    } else if (kw == "points") {
        if ((e = onlyFor(Kind::LineSeries)) || (e = once()) || (e = Count(t, 2, "points N")) ||
            (e = Int(t[1], 1, kMaxValuesPerStep, m_h.points, "the number of points")))
            return e;
    } else if (kw == "grid") {
        if ((e = onlyFor(Kind::Grid)) || (e = once()) || (e = Count(t, 3, "grid COLUMNS ROWS")) ||
            (e = Int(t[1], 1, kMaxValuesPerStep, m_h.columns, "the number of columns")) ||
            (e = Int(t[2], 1, kMaxValuesPerStep, m_h.rows, "the number of rows")))
            return e;
        if (m_h.columns > kMaxValuesPerStep / m_h.rows)
            return Fail(m_line, t[2].column,
                        "the grid has more than " + std::to_string(kMaxValuesPerStep) + " cells");
    } else if (kw == "origin") {
        if ((e = onlyFor(Kind::Grid)) || (e = once()) || (e = Count(t, 3, "origin X Y")) ||
            (e = Real(t[1], m_h.x0, "x")) || (e = Real(t[2], m_h.y0, "y")))
            return e;
    } else if (kw == "cell_size") {
        if ((e = onlyFor(Kind::Grid)) || (e = once()) || (e = Count(t, 3, "cell_size DX DY")) ||
            (e = Real(t[1], m_h.dx, "the cell width")) || (e = Real(t[2], m_h.dy, "the cell height")))
            return e;
        if (!(m_h.dx > 0) || !(m_h.dy > 0))
            return Fail(m_line, t[1].column, "the cell size must be more than 0");
    } else if (kw == "nodes" || kw == "elements") {
        if ((e = onlyFor(Kind::MeshData)))
            return e;
        for (const auto& [name, line] : m_seen)
            if (name == "nodes" || name == "elements")
                return Fail(m_line, t[0].column,
                            "\"" + kw + "\" after \"" + name + "\" on line " + std::to_string(line) +
                                ": the values lie either on the nodes or on the elements");
        m_seen.emplace_back(kw, m_line);
        if ((e = Count(t, 2, kw == "nodes" ? "nodes N" : "elements N")) ||
            (e = Int(t[1], 1, kMaxValuesPerStep, m_h.count,
                     kw == "nodes" ? "the number of nodes" : "the number of elements")))
            return e;
        m_h.location = kw == "nodes" ? MeshLocation::Nodes : MeshLocation::Elements;
    } else {
        return Fail(m_line, t[0].column, "unknown keyword \"" + kw + "\"");
    }
    return std::nullopt;
}

std::optional<Error> HeaderParser::Finish() {
    auto missing = [&](const char* what) {
        return Fail(m_line, 1, std::string("the header has no \"") + what + "\" line");
    };
    for (const char* kw : {"start", "step", "steps", "items"})
        if (std::none_of(m_seen.begin(), m_seen.end(), [&](const auto& s) { return s.first == kw; }))
            return missing(kw);
    if (static_cast<std::int64_t>(m_h.items.size()) != m_declaredItems)
        return Fail(m_line, 1,
                    "\"items\" on line " + std::to_string(m_itemsLine) + " announces " +
                        std::to_string(m_declaredItems) + " items but " +
                        std::to_string(m_h.items.size()) + " item lines follow");
    switch (m_h.kind) {
    case Kind::LineSeries:
        if (m_h.points == 0)
            return missing("points");
        break;
    case Kind::Grid:
        if (m_h.columns == 0)
            return missing("grid");
        break;
    case Kind::MeshData:
        if (m_h.count == 0)
            return Fail(m_line, 1, "the header has neither a \"nodes\" nor an \"elements\" line");
        break;
    default:
        break;
    }
    const double total = static_cast<double>(m_h.time.steps) * static_cast<double>(m_h.items.size()) *
                         static_cast<double>(m_h.ValuesPerStep());
    if (total > 9e18)
        return Fail(m_line, 1, "the header announces more values than a file can hold");
    const double end = m_h.time.End();
    if (!(end < 1e15))
        return Fail(m_line, 1, "the time axis ends beyond any date");
    m_h.valuesLine = m_line + 1;
    return std::nullopt;
}

HeaderResult HeaderParser::Run() {
    std::vector<Token> t;
    std::optional<Error> error;
    auto fail = [](Error e) {
        HeaderResult r;
        r.error = std::move(e);
        return r;
    };
    while (NextLine(t, error)) {
        if (error)
            return fail(*error);
        if (t.empty())
            continue;
        if (!m_haveKind) {
            const auto kind = KindFromWord(t[0].text);
            if (!kind || t[0].quoted)
                return fail(Fail(m_line, t[0].column,
                                 "not a data file: the first line must name the kind "
                                 "(qrd0, qrd1, qrd2, qrdu) and the version, as in \"qrd0 1\""));
            std::int64_t version = 0;
            if ((error = Count(t, 2, "KIND 1")) ||
                (error = Int(t[1], 1, 1, version, "the format version")))
                return fail(*error);
            m_h.kind = *kind;
            m_h.kindWord = t[0].text;
            m_haveKind = true;
            const auto byName = KindFromExtension(m_name);
            if (byName && *byName != *kind)
                return fail(Fail(m_line, t[0].column,
                                 std::string("the file declares a ") + KindName(*kind) + " (" +
                                     t[0].text + ") but its name ends in the extension of a " +
                                     KindName(*byName)));
            continue;
        }
        if (t[0].text == "values" && !t[0].quoted) {
            if (t.size() > 1)
                return fail(Fail(m_line, t[1].column, "\"values\" stands alone on its line"));
            m_sawValues = true;
            if ((error = Finish()))
                return fail(*error);
            HeaderResult r;
            r.header = std::move(m_h);
            return r;
        }
        if (t[0].quoted)
            return fail(Fail(m_line, t[0].column, "a header line starts with a keyword"));
        if ((error = Keyword(t)))
            return fail(*error);
    }
    if (m_src.ReadFailed())
        return fail(Fail(m_src.Line(), m_src.Column(), "the file cannot be read to its end"));
    if (!m_haveKind)
        return fail(Fail(m_src.Line(), m_src.Column(), "the file is empty"));
    return fail(Fail(m_src.Line(), m_src.Column(),
                     "the header ends without a \"values\" line (the file is cut short)"));
}

// Data files and point files are opened alike; the messages keep the words the selector
// and the command line have always shown.
std::optional<Error> OpenFile(fileio::InFile& file, const std::string& path,
                              const fileio::FileKind& kind = fileio::kDataFiles) {
    const std::optional<fileio::Failure> failure = file.Open(path, kind);
    if (!failure)
        return std::nullopt;
    if (failure->err == ENOENT)
        return Error{path, 0, 0, "the file does not exist"};
    if (failure->err == EISDIR)
        return Error{path, 0, 0, "this is a folder, not a data file"};
    if (!failure->reason.empty())
        return Error{path, 0, 0, "the file " + failure->reason};
    return Error{path, 0, 0, std::string("the file cannot be read: ") + std::strerror(failure->err)};
}

ValuesResult ParseValuesFrom(Source& src, const std::string& name, const ValuesRequest& req,
                             Header* out) {
    ValuesResult r;
    HeaderResult hr = HeaderParser(src, name).Run();
    if (hr.error) {
        r.error = std::move(hr.error);
        return r;
    }
    const Header& h = *hr.header;
    const std::int64_t perStep = h.ValuesPerStep();
    const std::int64_t items = static_cast<std::int64_t>(h.items.size());
    const std::int64_t total = h.time.steps * items * perStep;
    // Which item's slot each item fills in a row (-1: not wanted).
    std::vector<int> slot(h.items.size(), -1);
    for (std::size_t k = 0; k < req.items.size(); ++k)
        if (req.items[k] >= 0 && req.items[k] < items)
            slot[static_cast<std::size_t>(req.items[k])] = static_cast<int>(k);
    const std::int64_t stepsWanted = std::min(req.maxSteps, h.time.steps);
    if (!req.items.empty() && stepsWanted > 0)
        r.rows.reserve(static_cast<std::size_t>(std::min<std::int64_t>(stepsWanted, 1 << 20)));
    bool first = true;
    std::int64_t step = 0, item = 0, point = 0;
    std::string token;
    auto separator = [](int c) {
        return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == ',' || c == ';';
    };
    for (;;) {
        int c = src.Peek();
        if (c == EOF)
            break;
        if (separator(c)) {
            src.Get();
            continue;
        }
        if (c == '#') {
            while ((c = src.Peek()) != EOF && c != '\n')
                src.Get();
            continue;
        }
        const int line = src.Line();
        const int column = src.Column();
        token.clear();
        bool tooLong = false;
        while ((c = src.Peek()) != EOF && !separator(c) && c != '#') {
            if (token.size() < 64)
                token += static_cast<char>(c);
            else
                tooLong = true;
            src.Get();
        }
        if (r.valuesRead >= total) {
            r.error = Error{name, line, column,
                            "more values than the header announces (" + std::to_string(total) +
                                ")"};
            return r;
        }
        std::string_view s = token;
        if (!s.empty() && s[0] == '+')
            s.remove_prefix(1);
        double v = 0;
        const auto fc = std::from_chars(s.data(), s.data() + s.size(), v);
        if (tooLong || s.empty() || fc.ptr != s.data() + s.size() ||
            (fc.ec != std::errc() && fc.ec != std::errc::result_out_of_range)) {
            r.error = Error{name, line, column,
                            "\"" + token + (tooLong ? "...\"" : "\"") + " is not a number"};
            return r;
        }
        if (fc.ec == std::errc::result_out_of_range) {
            r.error = Error{name, line, column, "\"" + token + "\" is out of range"};
            return r;
        }
        if (point == req.point && slot[static_cast<std::size_t>(item)] >= 0 && step < stepsWanted) {
            if (static_cast<std::int64_t>(r.rows.size()) <= step)
                r.rows.emplace_back(req.items.size(), std::numeric_limits<double>::quiet_NaN());
            r.rows.back()[static_cast<std::size_t>(slot[static_cast<std::size_t>(item)])] = v;
            if (std::isfinite(v)) {
                if (first || v < r.minimum)
                    r.minimum = v;
                if (first || v > r.maximum)
                    r.maximum = v;
                first = false;
            }
        }
        ++r.valuesRead;
        if (++point == perStep) {
            point = 0;
            if (++item == items) {
                item = 0;
                ++step;
                if (!req.check && step >= stepsWanted)
                    break;
            }
        }
    }
    if (src.ReadFailed()) {
        r.error = Error{name, src.Line(), src.Column(), "the file cannot be read to its end"};
        return r;
    }
    if (req.check && r.valuesRead < total) {
        r.error = Error{name, src.Line(), src.Column(),
                        "the file ends after " + std::to_string(r.valuesRead) + " of " +
                            std::to_string(total) + " values (in time step " +
                            std::to_string(step + 1) + ", item " + std::to_string(item + 1) + ")"};
        return r;
    }
    if (out)
        *out = h;
    return r;
}

}  // namespace

const char* KindName(Kind kind) {
    switch (kind) {
    case Kind::TimeSeries:
        return "time series";
    case Kind::LineSeries:
        return "line series";
    case Kind::Grid:
        return "2D grid";
    case Kind::MeshData:
        return "mesh data";
    case Kind::Points:
        return "point file";
    }
    return "?";
}

const char* KindWord(Kind kind) {
    switch (kind) {
    case Kind::TimeSeries:
        return "qrd0";
    case Kind::LineSeries:
        return "qrd1";
    case Kind::Grid:
        return "qrd2";
    case Kind::MeshData:
        return "qrdu";
    case Kind::Points:
        return "xyz";
    }
    return "?";
}

std::optional<Kind> KindFromWord(std::string_view word) {
    if (word == "qrd0" || word == "kx0")
        return Kind::TimeSeries;
    if (word == "qrd1")
        return Kind::LineSeries;
    if (word == "qrd2" || word == "kx2")
        return Kind::Grid;
    if (word == "qrdu")
        return Kind::MeshData;
    return std::nullopt;
}

std::optional<Kind> KindFromExtension(std::string_view fileName) {
    const std::size_t dot = fileName.find_last_of('.');
    if (dot == std::string_view::npos || fileName.find_first_of("/\\", dot) != std::string_view::npos)
        return std::nullopt;
    const std::string_view ext = fileName.substr(dot + 1);
    for (const char* w : {"qrd0", "kx0", "qrd1", "qrd2", "kx2", "qrdu"})
        if (EqualsNoCase(ext, w))
            return KindFromWord(w);
    if (EqualsNoCase(ext, "xyz"))
        return Kind::Points;
    return std::nullopt;
}

std::string Error::ToString() const {
    if (line <= 0)
        return file + ": " + message;
    return file + ":" + std::to_string(line) + ":" + std::to_string(column) + ": " + message;
}

std::int64_t Header::ValuesPerStep() const {
    switch (kind) {
    case Kind::LineSeries:
        return points;
    case Kind::Grid:
        return columns * rows;
    case Kind::MeshData:
        return count;
    default:
        return 1;
    }
}

HeaderResult ReadHeader(const std::string& path) {
    HeaderResult r;
    fileio::InFile file;
    if ((r.error = OpenFile(file, path)))
        return r;
    Source src(file);
    return HeaderParser(src, path).Run();
}

HeaderResult ParseHeader(std::string_view text, const std::string& name) {
    Source src(text);
    return HeaderParser(src, name).Run();
}

ValuesResult ReadValues(const std::string& path, const ValuesRequest& request, Header* header) {
    fileio::InFile file;
    if (std::optional<Error> error = OpenFile(file, path)) {
        ValuesResult r;
        r.error = std::move(error);
        return r;
    }
    Source src(file);
    return ParseValuesFrom(src, path, request, header);
}

ValuesResult ParseValues(std::string_view text, const std::string& name,
                         const ValuesRequest& request, Header* header) {
    Source src(text);
    return ParseValuesFrom(src, name, request, header);
}

namespace {

// The file's text in pieces: flush takes out whenever it has grown past a block, and once
// at the end, so that a large file is never held whole.
void FormatInto(const Header& h, const std::vector<double>& values, std::string& out,
                const std::function<void(std::string&)>& flush) {
    constexpr std::size_t kBlock = 1 << 20;
    out = std::string(h.kindWord.empty() ? KindWord(h.kind) : h.kindWord.c_str()) + " 1\n";
    if (!h.title.empty())
        out += "title " + Quote(h.title) + "\n";
    out += "start " + FormatDateTime(h.time.start) + "\n";
    out += "step " + FormatNumber(h.time.step) + "\n";
    out += "steps " + std::to_string(h.time.steps) + "\n";
    switch (h.kind) {
    case Kind::LineSeries:
        out += "points " + std::to_string(h.points) + "\n";
        break;
    case Kind::Grid:
        out += "grid " + std::to_string(h.columns) + " " + std::to_string(h.rows) + "\n";
        out += "origin " + FormatNumber(h.x0) + " " + FormatNumber(h.y0) + "\n";
        out += "cell_size " + FormatNumber(h.dx) + " " + FormatNumber(h.dy) + "\n";
        break;
    case Kind::MeshData:
        out += std::string(h.location == MeshLocation::Nodes ? "nodes " : "elements ") +
               std::to_string(h.count) + "\n";
        break;
    default:
        break;
    }
    out += "items " + std::to_string(h.items.size()) + "\n";
    for (const Item& item : h.items)
        out += "item " + Quote(item.name) + " " + std::to_string(item.unitType) + " " +
               Quote(item.unit) + "\n";
    out += "values\n";
    const std::size_t perStep = static_cast<std::size_t>(std::max<std::int64_t>(h.ValuesPerStep(), 1));
    const std::size_t items = h.items.size();
    std::size_t i = 0;
    for (std::int64_t step = 0; step < h.time.steps && i < values.size(); ++step) {
        if (h.kind == Kind::TimeSeries) {
            for (std::size_t k = 0; k < items && i < values.size(); ++k)
                out += (k ? " " : "") + FormatNumber(values[i++]);
            out += '\n';
            continue;
        }
        out += "# step " + std::to_string(step + 1) + ": " +
               FormatDateTime(h.time.start + static_cast<std::int64_t>(std::llround(h.time.step * static_cast<double>(step)))) + "\n";
        for (std::size_t k = 0; k < items; ++k) {
            for (std::size_t p = 0; p < perStep && i < values.size(); ++p) {
                out += (p ? " " : "") + FormatNumber(values[i++]);
                if (out.size() >= kBlock)
                    flush(out);
            }
            out += '\n';
        }
        if (out.size() >= kBlock)
            flush(out);
    }
    flush(out);
}

}  // namespace

std::string FormatDataFile(const Header& h, const std::vector<double>& values) {
    std::string out, whole;
    FormatInto(h, values, out, [&whole](std::string& piece) {
        whole += piece;
        piece.clear();
    });
    return whole;
}

std::string CheckHeader(const Header& h) {
    if (!KindFromWord(h.kindWord.empty() ? KindWord(h.kind) : h.kindWord) || h.kind == Kind::Points)
        return std::string("a data file of this kind cannot be written here: ") + KindName(h.kind);
    const std::string text = FormatDataFile(h, {});
    HeaderResult r = ParseHeader(text, "");
    if (r.error)
        return r.error->message;
    return {};
}

bool WriteDataFile(const std::string& path, const Header& header, const std::vector<double>& values,
                   std::string* error) {
    auto fail = [&](std::string message) {
        if (error)
            *error = std::move(message);
        return false;
    };
    if (std::string problem = CheckHeader(header); !problem.empty())
        return fail(problem);
    const double expected = static_cast<double>(header.time.steps) *
                            static_cast<double>(header.items.size()) *
                            static_cast<double>(header.ValuesPerStep());
    if (static_cast<double>(values.size()) != expected)
        return fail("the header announces " + FormatNumber(expected) + " values but " +
                    std::to_string(values.size()) + " are given");
    fileio::AtomicWriter writer;
    std::optional<fileio::Failure> failure = writer.Open(path);
    std::string out;
    if (!failure)
        FormatInto(header, values, out, [&](std::string& piece) {
            if (!failure)
                failure = writer.Write(piece);
            piece.clear();
        });
    if (!failure)
        failure = writer.Commit();
    if (failure)
        return fail(path + ": " + failure->SystemText());
    return true;
}

// --- dates -----------------------------------------------------------------------------

namespace {

// Days since 1970-01-01 of a proleptic Gregorian date.
std::int64_t DaysFromCivil(std::int64_t y, unsigned m, unsigned d) {
    y -= m <= 2;
    const std::int64_t era = (y >= 0 ? y : y - 399) / 400;
    const unsigned yoe = static_cast<unsigned>(y - era * 400);
    const unsigned doy = (153 * (m + (m > 2 ? -3 : 9)) + 2) / 5 + d - 1;
    const unsigned doe = yoe * 365 + yoe / 4 - yoe / 100 + doy;
    return era * 146097 + static_cast<std::int64_t>(doe) - 719468;
}

void CivilFromDays(std::int64_t z, std::int64_t& y, unsigned& m, unsigned& d) {
    z += 719468;
    const std::int64_t era = (z >= 0 ? z : z - 146096) / 146097;
    const unsigned doe = static_cast<unsigned>(z - era * 146097);
    const unsigned yoe = (doe - doe / 1460 + doe / 36524 - doe / 146096) / 365;
    y = static_cast<std::int64_t>(yoe) + era * 400;
    const unsigned doy = doe - (365 * yoe + yoe / 4 - yoe / 100);
    const unsigned mp = (5 * doy + 2) / 153;
    d = doy - (153 * mp + 2) / 5 + 1;
    m = mp < 10 ? mp + 3 : mp - 9;
    y += m <= 2;
}

bool Digits(std::string_view s, std::size_t at, std::size_t n, int& out) {
    if (at + n > s.size())
        return false;
    out = 0;
    for (std::size_t i = at; i < at + n; ++i) {
        if (s[i] < '0' || s[i] > '9')
            return false;
        out = out * 10 + (s[i] - '0');
    }
    return true;
}

}  // namespace

std::optional<std::int64_t> ParseDateTime(std::string_view s) {
    int y, mo, d, h, mi, sec = 0;
    if (!Digits(s, 0, 4, y) || s.size() < 16 || s[4] != '-' || !Digits(s, 5, 2, mo) || s[7] != '-' ||
        !Digits(s, 8, 2, d) || (s[10] != ' ' && s[10] != 'T') || !Digits(s, 11, 2, h) ||
        s[13] != ':' || !Digits(s, 14, 2, mi))
        return std::nullopt;
    if (s.size() != 16 && (s.size() != 19 || s[16] != ':' || !Digits(s, 17, 2, sec)))
        return std::nullopt;
    static const int kDays[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    const bool leap = (y % 4 == 0 && y % 100 != 0) || y % 400 == 0;
    if (mo < 1 || mo > 12 || d < 1 || d > kDays[mo - 1] + (mo == 2 && leap) || h > 23 || mi > 59 ||
        sec > 59)
        return std::nullopt;
    return DaysFromCivil(y, static_cast<unsigned>(mo), static_cast<unsigned>(d)) * 86400 +
           h * 3600 + mi * 60 + sec;
}

std::string FormatDateTime(std::int64_t seconds) {
    std::int64_t days = seconds / 86400;
    std::int64_t rest = seconds % 86400;
    if (rest < 0) {
        rest += 86400;
        --days;
    }
    std::int64_t y;
    unsigned m, d;
    CivilFromDays(days, y, m, d);
    char buf[64];
    std::snprintf(buf, sizeof buf, "%04lld-%02u-%02u %02d:%02d:%02d", static_cast<long long>(y), m,
                  d, static_cast<int>(rest / 3600), static_cast<int>(rest / 60 % 60),
                  static_cast<int>(rest % 60));
    return buf;
}

std::string FormatDuration(double seconds) {
    struct Unit {
        double size;
        const char* one;
        const char* many;
    };
    static const Unit kUnits[] = {{86400, "day", "days"}, {3600, "h", "h"}, {60, "min", "min"}};
    for (const Unit& u : kUnits)
        if (std::fabs(seconds) >= u.size) {
            const double n = seconds / u.size;
            return FormatNumber(std::round(n * 1000) / 1000) + " " + (n == 1 ? u.one : u.many);
        }
    return FormatNumber(seconds) + " s";
}

std::string DescribeTimeAxis(const TimeAxis& t) {
    std::string s = std::to_string(t.steps) + (t.steps == 1 ? " time step" : " time steps");
    if (t.steps > 1)
        s += " of " + FormatDuration(t.step);
    s += " from " + FormatDateTime(t.start);
    if (t.steps > 1)
        s += " to " + FormatDateTime(static_cast<std::int64_t>(std::floor(t.End())));
    return s;
}

std::string DescribeLayout(const Header& h) {
    switch (h.kind) {
    case Kind::LineSeries:
        return std::to_string(h.points) + " points on the line";
    case Kind::Grid:
        return std::to_string(h.columns) + " x " + std::to_string(h.rows) + " cells from (" +
               FormatNumber(h.x0) + ", " + FormatNumber(h.y0) + "), cells of " + FormatNumber(h.dx) +
               " x " + FormatNumber(h.dy);
    case Kind::MeshData:
        return std::to_string(h.count) +
               (h.location == MeshLocation::Nodes ? " nodes of the mesh" : " elements of the mesh");
    default:
        return "one value per item and time step";
    }
}

std::string DescribeUnitType(long unitType) {
    if (const QuantityInfo* q = CUnitUtil::FindQuantity(unitType))
        return std::string(q->name) + " (" + std::to_string(unitType) + ")";
    return std::to_string(unitType);
}

// --- point files ------------------------------------------------------------------------

XyzResult ParseXyz(std::string_view text, const std::string& name) {
    XyzResult r;
    int line = 0;
    std::size_t pos = 0;
    while (pos < text.size()) {
        ++line;
        std::size_t end = text.find('\n', pos);
        if (end == std::string_view::npos)
            end = text.size();
        std::string_view l = text.substr(pos, end - pos);
        pos = end + 1;
        if (!l.empty() && l.back() == '\r')
            l.remove_suffix(1);
        std::size_t i = 0;
        auto skip = [&] {
            while (i < l.size() && (l[i] == ' ' || l[i] == '\t' || l[i] == ','))
                ++i;
        };
        skip();
        if (i == l.size() || l[i] == '#')
            continue;
        XyzPoint p;
        double* coords[] = {&p.x, &p.y, &p.z};
        for (int c = 0; c < 3; ++c) {
            skip();
            std::size_t j = i;
            while (j < l.size() && l[j] != ' ' && l[j] != '\t' && l[j] != ',')
                ++j;
            std::string_view s = l.substr(i, j - i);
            if (!s.empty() && s[0] == '+')
                s.remove_prefix(1);
            const auto fc = std::from_chars(s.data(), s.data() + s.size(), *coords[c]);
            if (s.empty() || fc.ec != std::errc() || fc.ptr != s.data() + s.size() ||
                !std::isfinite(*coords[c])) {
                r.error = Error{name, line, static_cast<int>(i) + 1,
                                std::string("expected \"x y z name\" (name optional): ") +
                                    (s.empty() ? "the " + std::string(c == 0 ? "x" : c == 1 ? "y" : "z") +
                                                     " value is missing"
                                               : "\"" + std::string(l.substr(i, j - i)) +
                                                     "\" is not a number")};
                r.points.clear();
                return r;
            }
            i = j;
        }
        skip();
        std::string_view rest = l.substr(i);
        while (!rest.empty() && (rest.back() == ' ' || rest.back() == '\t'))
            rest.remove_suffix(1);
        p.name = std::string(rest);
        r.points.push_back(std::move(p));
    }
    return r;
}

XyzResult ReadXyz(const std::string& path) {
    XyzResult r;
    fileio::InFile file;
    if ((r.error = OpenFile(file, path, fileio::kPointFiles)))
        return r;
    std::string text(static_cast<std::size_t>(file.Size()), '\0');
    const std::ptrdiff_t n = file.Read(text.data(), text.size());
    if (n < 0) {
        r.error = Error{path, 0, 0, "the file cannot be read to its end"};
        return r;
    }
    // A file that shrank while it was read holds only what was read.
    text.resize(static_cast<std::size_t>(n));
    return ParseXyz(text, path);
}

}  // namespace datafile
