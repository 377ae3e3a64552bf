// The .2dm text format, one card a line:
//   MESH2D                          first line (optional here)
//   ND id x y z                     a node; ids are labels from 0, any order, with gaps
//   E3T id n1 n2 n3 [material]      a triangle
//   E4Q id n1 n2 n3 n4 [material]   a quadrilateral
//   E6T, E8Q, E9Q                   quadratic elements: corners and mid-side nodes in turn
//   E2L, E3L                        line elements, passed over
//   NS n1 n2 ... -nk [code] [name]  an open boundary: a node string over one or more NS
//                                   lines, its last node negative, then optionally the
//                                   boundary's code and name
// MESHNAME and NUM_MATERIALS_PER_ELEM are passed over; other cards (MAT, BEGPARAMDEF ...
// ENDPARAMDEF, ...) with a note.
#include "MeshReader.h"
#include "fileio/GuardedFile.h"

#include <algorithm>
#include <charconv>
#include <climits>
#include <cmath>
#include <cstdint>
#include <optional>
#include <set>
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
    // The line from the start of token t (taken from this line) to its end, trimmed.
    std::string_view From(std::string_view t) const {
        std::string_view r = m_s.substr(static_cast<size_t>(t.data() - m_s.data()));
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

bool IsUtf8(std::string_view s) {
    const auto* p = reinterpret_cast<const unsigned char*>(s.data());
    const auto* e = p + s.size();
    while (p < e) {
        const unsigned c = *p;
        const int n = c < 0x80         ? 0
                      : (c >> 5) == 6  ? 1
                      : (c >> 4) == 14 ? 2
                      : (c >> 3) == 30 ? 3
                                       : -1;
        if (n < 0 || (n == 1 && c < 0xc2) || (n == 3 && c > 0xf4) || e - p <= n)
            return false;
        for (int i = 1; i <= n; ++i)
            if ((p[i] & 0xc0) != 0x80)
                return false;
        // Overlong three- and four-byte forms, surrogates and code points beyond U+10FFFF.
        if ((n == 2 && ((c == 0xe0 && p[1] < 0xa0) || (c == 0xed && p[1] > 0x9f))) ||
            (n == 3 && ((c == 0xf0 && p[1] < 0x90) || (c == 0xf4 && p[1] > 0x8f))))
            return false;
        p += n + 1;
    }
    return true;
}

std::string Count(size_t n, const char* one, const char* many) {
    return std::to_string(n) + " " + (n == 1 ? one : many);
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
        return id >= 0 && static_cast<size_t>(id) < m_dense.size()
                   ? m_dense[static_cast<size_t>(id)]
                   : -1;
    }

private:
    size_t m_count = 0;
    bool m_isSparse = false;
    std::vector<int> m_dense;
    std::unordered_map<long long, int> m_sparse;
};

constexpr long long kNoNode = -1;

struct PendingString {
    size_t line;
    std::vector<long long> ids;
    int code = 0;
    bool hasCode = false;
    std::string name;
};

struct Parser {
    CMesh& mesh;
    std::vector<long long> elementIds; // node ids, four per element (kNoNode for none)
    std::vector<size_t> elementLines;
    // Mid-side and centre nodes of quadratic elements, with their lines.
    std::vector<std::pair<long long, size_t>> midIds;
    size_t quadratic = 0, lineElements = 0;
    std::vector<PendingString> strings;
    bool inString = false;
    std::string_view blockEnd; // the card that ends the block being passed over
    std::set<std::string, std::less<>> passedOver;
    NodeIds nodes;

    std::optional<Error> Line(std::string_view s, size_t line) {
        Tokens t(s);
        std::string_view card;
        if (!t.Next(card) || card.front() == '#')
            return std::nullopt;
        if (card == "ND")
            return Node(t, line);
        if (card == "E3T")
            return Element(t, line, 3, 3);
        if (card == "E4Q")
            return Element(t, line, 4, 4);
        if (card == "NS")
            return NodeString(t, line);
        if (card == "E6T")
            return Element(t, line, 3, 6);
        if (card == "E8Q")
            return Element(t, line, 4, 8);
        if (card == "E9Q")
            return Element(t, line, 4, 9);
        if (card == "E2L" || card == "E3L") {
            ++lineElements;
            return std::nullopt;
        }
        // Blocks of other tools' data are passed over whole; mesh cards inside them are
        // still read, so that a block never ended loses nothing.
        if (!blockEnd.empty()) {
            if (card == blockEnd)
                blockEnd = {};
            return std::nullopt;
        }
        // Cards that only describe the file.
        if (card == "MESH2D" || card == "MESHNAME" || card == "NUM_MATERIALS_PER_ELEM")
            return std::nullopt;
        if (card == "BEGPARAMDEF")
            blockEnd = "ENDPARAMDEF";
        else if (card == "BEGCURVE")
            blockEnd = "ENDCURVE";
        else if (card == "BEG2DMBC")
            blockEnd = "END2DMBC";
        // A few names are enough to say what was there; any text must not grow the set.
        if (passedOver.size() < 12 && card.size() <= 32 && IsUtf8(card))
            passedOver.emplace(card);
        return std::nullopt;
    }

    std::optional<Error> Node(Tokens& t, size_t line) {
        std::string_view a, b, c, d;
        long long id = 0;
        double x = 0, y = 0, z = 0;
        if (!t.Next(a) || !t.Next(b) || !t.Next(c) || !t.Next(d))
            return Error{line, "ND needs an id and x, y, z"};
        if (!ToInt(a, id) || id < 0 || id > INT32_MAX)
            return Error{line, "node id " + std::string(a) + " is not a whole number from 0"};
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

    // An element of `listed` node ids; a quadratic one (listed > corners) names corner and
    // mid-side nodes in turn, then the centre node.
    std::optional<Error> Element(Tokens& t, size_t line, int corners, int listed) {
        std::string_view tok;
        long long id = 0;
        if (!t.Next(tok) || !ToInt(tok, id) || id < 0)
            return Error{line, "element id missing or not a whole number from 0"};
        long long n[9] = {};
        for (int i = 0; i < listed; ++i) {
            if (!t.Next(tok))
                return Error{line, "element " + std::to_string(id) + " needs " +
                                       std::to_string(listed) + " nodes"};
            if (!ToInt(tok, n[i]) || n[i] < 0)
                return Error{line, "element " + std::to_string(id) + ": node id " +
                                       std::string(tok) + " is not a whole number from 0"};
            for (int j = 0; j < i; ++j)
                if (n[j] == n[i])
                    return Error{line, "element " + std::to_string(id) + " names node " +
                                           std::string(tok) + " twice"};
        }
        if (elementLines.size() >= static_cast<size_t>(INT32_MAX))
            return Error{line, "too many elements"};
        const int step = listed == corners ? 1 : 2;
        for (int i = 0; i < 4; ++i)
            elementIds.push_back(i < corners ? n[i * step] : kNoNode);
        if (step == 2) {
            ++quadratic;
            for (int i = 1; i < 2 * corners; i += 2)
                midIds.push_back({n[i], line});
            if (listed > 2 * corners)
                midIds.push_back({n[2 * corners], line});
        }
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
            if (!ToInt(tok, id) || id == LLONG_MIN)
                return Error{line, "node string: " + std::string(tok) + " is not a node id"};
            // "-0" ends a string at node 0.
            const bool last = tok.front() == '-';
            ns.ids.push_back(last ? -id : id);
            if (!last)
                continue;
            inString = false;
            if (ns.ids.size() < 2)
                return Error{ns.line, "a node string needs at least two nodes"};
            if (!t.Next(tok))
                return std::nullopt;
            // Only a number is a code; a word is where the name begins.
            long long code = 0;
            if (ToInt(tok, code)) {
                if (code < INT32_MIN || code > INT32_MAX)
                    return Error{line, "node string: code " + std::string(tok) + " is too large"};
                ns.code = static_cast<int>(code);
                ns.hasCode = true;
                if (!t.Next(tok))
                    return std::nullopt;
            }
            std::string_view name = t.From(tok);
            if (name.size() >= 2 && name.front() == '"' && name.back() == '"')
                name = name.substr(1, name.size() - 2);
            ns.name = std::string(name);
            if (!IsUtf8(name))
                mesh.notes.push_back("line " + std::to_string(line) +
                                     ": the boundary name is not valid UTF-8; kept byte for byte");
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
            return Error{0, lineElements ? "no triangles or quadrilaterals (E3T, E4Q), only " +
                                               Count(lineElements, "line element", "line elements")
                                         : std::string("no elements (E3T, E4Q)")};
        mesh.elements.resize(elementLines.size());
        for (size_t e = 0; e < elementLines.size(); ++e)
            for (int i = 0; i < 4; ++i) {
                const long long id = elementIds[4 * e + i];
                if (id == kNoNode) {
                    mesh.elements[e][i] = -1;
                    continue;
                }
                const int index = nodes.Find(id);
                if (index < 0)
                    return Error{elementLines[e], "element names node " + std::to_string(id) +
                                                      ", which does not exist"};
                mesh.elements[e][i] = index;
            }
        for (const auto& [id, line] : midIds)
            if (nodes.Find(id) < 0)
                return Error{line,
                             "element names node " + std::to_string(id) + ", which does not exist"};
        std::unordered_set<int> codes;
        for (const PendingString& ns : strings)
            if (ns.hasCode && !codes.insert(ns.code).second)
                return Error{ns.line,
                             "boundary code " + std::to_string(ns.code) + " is used twice"};
        // Strings without a code are numbered in file order, past the codes that are taken.
        int next = 2;
        for (size_t s = 0; s < strings.size(); ++s) {
            PendingString& ns = strings[s];
            MeshBoundary b;
            if (ns.hasCode) {
                b.code = ns.code;
            } else {
                next = std::max(next, static_cast<int>(s) + 2);
                while (codes.count(next))
                    ++next;
                b.code = next++;
            }
            b.name = ns.name.empty() ? "Boundary " + std::to_string(s + 1) : ns.name;
            for (long long id : ns.ids) {
                const int index = nodes.Find(id);
                if (index < 0)
                    return Error{ns.line, "node string names node " + std::to_string(id) +
                                              ", which does not exist"};
                b.nodes.push_back(index);
            }
            mesh.boundaries.push_back(std::move(b));
        }
        if (quadratic)
            DropMidSideNodes();
        if (lineElements)
            mesh.notes.push_back(Count(lineElements, "line element", "line elements") +
                                 " (E2L, E3L) passed over");
        if (!passedOver.empty()) {
            std::string list;
            for (const std::string& c : passedOver)
                list += (list.empty() ? "" : ", ") + c;
            mesh.notes.push_back("cards of other tools passed over: " + list);
        }
        mesh.Finish();
        return std::nullopt;
    }

    // The flow model takes linear elements: quadratic ones keep their corners, and nodes
    // that only ever sit between corners leave the mesh and its boundaries.
    void DropMidSideNodes() {
        const size_t n = mesh.NodeCount();
        std::vector<char> corner(n, 0), mid(n, 0);
        for (const CMesh::Element& e : mesh.elements)
            for (int i = 0; i < CMesh::Corners(e); ++i)
                corner[static_cast<size_t>(e[i])] = 1;
        for (const auto& m : midIds)
            if (const int i = nodes.Find(m.first); i >= 0)
                mid[static_cast<size_t>(i)] = 1;
        std::vector<int> to(n, -1);
        size_t kept = 0;
        for (size_t i = 0; i < n; ++i)
            if (corner[i] || !mid[i]) {
                to[i] = static_cast<int>(kept);
                mesh.x[kept] = mesh.x[i], mesh.y[kept] = mesh.y[i], mesh.z[kept] = mesh.z[i];
                ++kept;
            }
        const size_t dropped = n - kept;
        mesh.x.resize(kept), mesh.y.resize(kept), mesh.z.resize(kept);
        for (CMesh::Element& e : mesh.elements)
            for (int i = 0; i < CMesh::Corners(e); ++i)
                e[i] = to[static_cast<size_t>(e[i])];
        for (MeshBoundary& b : mesh.boundaries) {
            std::vector<int> on;
            for (int i : b.nodes)
                if (to[static_cast<size_t>(i)] >= 0)
                    on.push_back(to[static_cast<size_t>(i)]);
            b.nodes = std::move(on);
        }
        const auto few = [](const MeshBoundary& b) { return b.nodes.size() < 2; };
        for (const MeshBoundary& b : mesh.boundaries)
            if (few(b))
                mesh.notes.push_back("boundary \"" + b.name +
                                     "\" passed over: it has no two corner nodes");
        mesh.boundaries.erase(std::remove_if(mesh.boundaries.begin(), mesh.boundaries.end(), few),
                              mesh.boundaries.end());
        mesh.notes.push_back(
            Count(quadratic, "quadratic element", "quadratic elements") +
            " (E6T, E8Q, E9Q) read by their corner nodes; the mid-side nodes are not used (" +
            Count(dropped, "node", "nodes") + " left out)");
    }
};

} // namespace

MeshReadResult Read2dm(std::string_view text, const std::string& fileName) {
    auto mesh = std::make_shared<CMesh>();
    Parser p{*mesh, {}, {}, {}, 0, 0, {}, false, {}, {}, {}};
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
