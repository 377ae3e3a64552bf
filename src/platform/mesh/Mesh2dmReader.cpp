// The .2dm text format, one card a line:
//   MESH2D                          first line (optional here)
//   ND id x y z                     a node; ids from 1, any order, need not be contiguous
//   E3T id n1 n2 n3 [material]      a triangle
//   E4Q id n1 n2 n3 n4 [material]   a quadrilateral
//   NS n1 n2 ... -nk [code [name]]  an open boundary: a node string over one or more NS
//                                   lines, its last node negative, then optionally the
//                                   boundary's code and name
// Other cards (MESHNAME, NUM_MATERIALS_PER_ELEM, BEGPARAMDEF, ...) are passed over.
#include "MeshReader.h"
#include "fileio/GuardedFile.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <optional>
#include <sstream>
#include <unordered_map>
#include <unordered_set>

namespace {

struct Error {
    size_t line;
    std::string message;
};

class Tokens {
public:
    explicit Tokens(std::string_view s) : m_s(s) {}
    bool Next(std::string_view& t) {
        while (m_p < m_s.size() && (m_s[m_p] == ' ' || m_s[m_p] == '\t'))
            ++m_p;
        if (m_p >= m_s.size())
            return false;
        const size_t b = m_p;
        while (m_p < m_s.size() && m_s[m_p] != ' ' && m_s[m_p] != '\t')
            ++m_p;
        t = m_s.substr(b, m_p - b);
        return true;
    }
    std::string_view Rest() {
        while (m_p < m_s.size() && (m_s[m_p] == ' ' || m_s[m_p] == '\t'))
            ++m_p;
        std::string_view r = m_s.substr(m_p);
        while (!r.empty() && (r.back() == ' ' || r.back() == '\t'))
            r.remove_suffix(1);
        return r;
    }

private:
    std::string_view m_s;
    size_t m_p = 0;
};

bool ToInt(std::string_view t, long long& v) {
    const auto [end, ec] = std::from_chars(t.data(), t.data() + t.size(), v);
    return ec == std::errc() && end == t.data() + t.size();
}
bool ToDouble(std::string_view t, double& v) {
    if (!t.empty() && t.front() == '+')
        t.remove_prefix(1);
    const auto [end, ec] = std::from_chars(t.data(), t.data() + t.size(), v);
    return ec == std::errc() && end == t.data() + t.size() && std::isfinite(v);
}

// Node ids to indices: a table while the ids are dense, a hash map when a file uses a few
// large ones.
class NodeIds {
public:
    bool Add(long long id, int index) {
        ++m_count;
        // The table never grows beyond a few entries a node, whatever ids a file uses.
        if (!m_isSparse && static_cast<double>(id) < 4.0 * static_cast<double>(m_count) + 65536) {
            if (static_cast<size_t>(id) >= m_dense.size())
                m_dense.resize(std::max(static_cast<size_t>(id) + 1, m_dense.size() * 3 / 2), -1);
            if (m_dense[static_cast<size_t>(id)] >= 0)
                return false;
            m_dense[static_cast<size_t>(id)] = index;
            return true;
        }
        if (!m_isSparse) {
            for (size_t i = 0; i < m_dense.size(); ++i)
                if (m_dense[i] >= 0)
                    m_sparse.emplace(static_cast<long long>(i), m_dense[i]);
            m_dense = {};
            m_isSparse = true;
        }
        return m_sparse.emplace(id, index).second;
    }
    int Find(long long id) const {
        if (m_isSparse) {
            const auto it = m_sparse.find(id);
            return it == m_sparse.end() ? -1 : it->second;
        }
        return id > 0 && static_cast<size_t>(id) < m_dense.size() ? m_dense[static_cast<size_t>(id)]
                                                                  : -1;
    }

private:
    size_t m_count = 0;
    bool m_isSparse = false;
    std::vector<int> m_dense;
    std::unordered_map<long long, int> m_sparse;
};

struct PendingString {
    size_t line;
    std::vector<long long> ids;
    int code = 0;
    bool hasCode = false;
    std::string name;
};

struct Parser {
    CMesh& mesh;
    std::vector<long long> elementIds; // node ids, four per element (0 for none)
    std::vector<size_t> elementLines;
    std::vector<PendingString> strings;
    bool inString = false;
    NodeIds nodes;

    std::optional<Error> Line(std::string_view s, size_t line) {
        Tokens t(s);
        std::string_view card;
        if (!t.Next(card) || card.front() == '#')
            return std::nullopt;
        if (card == "ND")
            return Node(t, line);
        if (card == "E3T" || card == "E4Q")
            return Element(t, line, card == "E3T" ? 3 : 4);
        if (card == "NS")
            return NodeString(t, line);
        if (card == "E2L" || card == "E3L" || card == "E6T" || card == "E8Q" || card == "E9Q")
            return Error{line, "element type " + std::string(card) +
                                   " is not supported (E3T and E4Q only)"};
        return std::nullopt;
    }

    std::optional<Error> Node(Tokens& t, size_t line) {
        std::string_view a, b, c, d;
        long long id = 0;
        double x = 0, y = 0, z = 0;
        if (!t.Next(a) || !t.Next(b) || !t.Next(c) || !t.Next(d))
            return Error{line, "ND needs an id and x, y, z"};
        if (!ToInt(a, id) || id < 1 || id > INT32_MAX)
            return Error{line, "node id " + std::string(a) + " is not a number from 1"};
        if (!ToDouble(b, x) || !ToDouble(c, y) || !ToDouble(d, z))
            return Error{line, "node " + std::string(a) + " has a coordinate that is not a number"};
        if (mesh.x.size() >= static_cast<size_t>(INT32_MAX))
            return Error{line, "too many nodes"};
        if (!nodes.Add(id, static_cast<int>(mesh.x.size())))
            return Error{line, "node " + std::string(a) + " is defined twice"};
        mesh.x.push_back(x);
        mesh.y.push_back(y);
        mesh.z.push_back(z);
        return std::nullopt;
    }

    std::optional<Error> Element(Tokens& t, size_t line, int corners) {
        std::string_view tok;
        long long id = 0;
        if (!t.Next(tok) || !ToInt(tok, id) || id < 1)
            return Error{line, "element id missing or not a number from 1"};
        long long n[4] = {0, 0, 0, 0};
        for (int i = 0; i < corners; ++i) {
            if (!t.Next(tok))
                return Error{line, "element " + std::to_string(id) + " needs " +
                                       std::to_string(corners) + " nodes"};
            if (!ToInt(tok, n[i]) || n[i] < 1)
                return Error{line, "element " + std::to_string(id) + ": node id " +
                                       std::string(tok) + " is not a number from 1"};
            for (int j = 0; j < i; ++j)
                if (n[j] == n[i])
                    return Error{line, "element " + std::to_string(id) + " names node " +
                                           std::string(tok) + " twice"};
        }
        if (elementLines.size() >= static_cast<size_t>(INT32_MAX))
            return Error{line, "too many elements"};
        elementIds.insert(elementIds.end(), n, n + 4);
        elementLines.push_back(line);
        return std::nullopt;
    }

    std::optional<Error> NodeString(Tokens& t, size_t line) {
        if (!inString) {
            strings.push_back({line, {}, 0, false, {}});
            inString = true;
        }
        PendingString& ns = strings.back();
        std::string_view tok;
        while (t.Next(tok)) {
            long long id = 0;
            if (!ToInt(tok, id) || id == 0)
                return Error{line, "node string: " + std::string(tok) + " is not a node id"};
            ns.ids.push_back(id < 0 ? -id : id);
            if (id > 0)
                continue;
            inString = false;
            if (ns.ids.size() < 2)
                return Error{ns.line, "a node string needs at least two nodes"};
            if (t.Next(tok)) {
                long long code = 0;
                if (!ToInt(tok, code) || code < INT32_MIN || code > INT32_MAX)
                    return Error{line,
                                 "node string: code " + std::string(tok) + " is not a number"};
                ns.code = static_cast<int>(code);
                ns.hasCode = true;
                std::string_view name = t.Rest();
                if (name.size() >= 2 && name.front() == '"' && name.back() == '"')
                    name = name.substr(1, name.size() - 2);
                ns.name = std::string(name);
            }
            return std::nullopt;
        }
        return std::nullopt;
    }

    std::optional<Error> Finish() {
        if (inString)
            return Error{strings.back().line,
                         "node string not ended (its last node id must be negative)"};
        if (mesh.x.empty())
            return Error{0, "no nodes (ND)"};
        if (elementLines.empty())
            return Error{0, "no elements (E3T, E4Q)"};
        mesh.elements.resize(elementLines.size());
        for (size_t e = 0; e < elementLines.size(); ++e)
            for (int i = 0; i < 4; ++i) {
                const long long id = elementIds[4 * e + i];
                if (id == 0) {
                    mesh.elements[e][i] = -1;
                    continue;
                }
                const int index = nodes.Find(id);
                if (index < 0)
                    return Error{elementLines[e], "element names node " + std::to_string(id) +
                                                      ", which does not exist"};
                mesh.elements[e][i] = index;
            }
        std::unordered_set<int> codes;
        for (size_t s = 0; s < strings.size(); ++s) {
            PendingString& ns = strings[s];
            MeshBoundary b;
            b.code = ns.hasCode ? ns.code : static_cast<int>(s) + 2;
            b.name = ns.name.empty() ? "Boundary " + std::to_string(s + 1) : ns.name;
            if (!codes.insert(b.code).second)
                return Error{ns.line, "boundary code " + std::to_string(b.code) + " is used twice"};
            for (long long id : ns.ids) {
                const int index = nodes.Find(id);
                if (index < 0)
                    return Error{ns.line, "node string names node " + std::to_string(id) +
                                              ", which does not exist"};
                b.nodes.push_back(index);
            }
            mesh.boundaries.push_back(std::move(b));
        }
        mesh.Finish();
        return std::nullopt;
    }
};

} // namespace

MeshReadResult Read2dm(std::string_view text, const std::string& fileName) {
    auto mesh = std::make_shared<CMesh>();
    Parser p{*mesh, {}, {}, {}, false, {}};
    // About 40 bytes a node line: enough to skip most of the growing.
    mesh->x.reserve(text.size() / 120);
    mesh->y.reserve(text.size() / 120);
    mesh->z.reserve(text.size() / 120);
    size_t line = 0, pos = 0;
    std::optional<Error> err;
    while (pos < text.size() && !err) {
        size_t end = text.find('\n', pos);
        if (end == std::string_view::npos)
            end = text.size();
        std::string_view s = text.substr(pos, end - pos);
        if (!s.empty() && s.back() == '\r')
            s.remove_suffix(1);
        ++line;
        err = p.Line(s, line);
        pos = end + 1;
    }
    if (!err && text.find_first_not_of(" \t\r\n") == std::string_view::npos)
        err = Error{0, "the file is empty"};
    if (!err)
        err = p.Finish();
    if (err) {
        const std::string where = err->line ? fileName + ":" + std::to_string(err->line) : fileName;
        return {nullptr, where + ": " + err->message};
    }
    return {std::move(mesh), {}};
}

MeshReadResult ReadMeshFile(const std::string& path) {
    const size_t dot = path.find_last_of('.');
    const std::string ext = dot == std::string::npos ? std::string() : path.substr(dot);
    if (ext == ".nc" || ext == ".nc4" || ext == ".cdf")
        return ReadUgrid(path);
    // Sniffed without reading: a netCDF file may be far larger than a text mesh.
    fileio::InFile in;
    if (const auto failure = in.Open(path, fileio::kNetcdfFiles))
        return {nullptr, path + ": " + failure->Text()};
    char magic[4] = {};
    if (in.Size() >= 4 && in.ReadAt(0, magic, 4) &&
        ((magic[0] == 'C' && magic[1] == 'D' && magic[2] == 'F') ||
         (magic[0] == '\x89' && magic[1] == 'H' && magic[2] == 'D' && magic[3] == 'F')))
        return ReadUgrid(path);
    in.Close();
    std::string text;
    if (const auto failure = fileio::ReadWholeFile(path, fileio::kMeshFiles, text))
        return {nullptr, path + ": " + failure->Text()};
    return Read2dm(text, path);
}
