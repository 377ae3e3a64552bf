// datafile info, datafile new: look into a data file, or make one.
#include "Commands.h"

#include "datafile/DataFile.h"
#include "fem/UnitUtil.h"
#include "fileio/GuardedFile.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <cmath>
#include <iostream>
#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

namespace cli {
namespace {

const char* const kDatafileHelp =
    "usage: mudsetup datafile info FILE [--header-only]\n"
    "       mudsetup datafile new KIND --item NAME:UNITTYPE[:UNIT] ... --start TIME --step SECONDS\n"
    "                             [--steps N] [LAYOUT] [--title TEXT] [--from CSV] -o FILE\n"
    "Inspects or makes a data file (.qrd0, .qrd1, .qrd2, .qrdu, .kx0, .kx2; info also .xyz).\n"
    "See mudsetup datafile info --help and mudsetup datafile new --help.\n";
const char* const kInfoHelp =
    "usage: mudsetup datafile info FILE [--header-only]\n"
    "Prints the kind, the title, the time axis, where the values lie and the items with\n"
    "their unit types and units; for a point file (.xyz) the number of points and their\n"
    "extent. The values are checked as well unless --header-only is given.\n"
    "Exit status: 0 a valid file, 2 a file that cannot be read or is not valid\n"
    "(FILE:LINE:COLUMN: message on standard error).\n";
const char* const kNewHelp =
    "usage: mudsetup datafile new KIND --item NAME:UNITTYPE[:UNIT] ... --start TIME --step SECONDS\n"
    "                             [--steps N] [LAYOUT] [--title TEXT] [--from CSV] -o FILE\n"
    "Writes a data file. KIND: qrd0 (time series), qrd1 (line series), qrd2 (2D grid),\n"
    "qrdu (mesh data), or the older kx0 and kx2.\n"
    "  --item NAME:UNITTYPE[:UNIT]  one per item, in order; UNITTYPE is a unit-type code or\n"
    "                               a quantity's name (\"Wave height\"); UNIT defaults to the\n"
    "                               quantity's first unit\n"
    "  --start \"yyyy-MM-dd HH:mm:ss\" and --step SECONDS: the time axis\n"
    "  --steps N                    number of time steps (from the CSV rows when not given)\n"
    "  LAYOUT                       qrd1: --points N; qrd2: --grid COLUMNS,ROWS\n"
    "                               [--origin X,Y] [--cell-size DX,DY]; qrdu: --nodes N or\n"
    "                               --elements N\n"
    "  --from CSV                   the values, one row per time step: item 1 at every\n"
    "                               point, then item 2, ...; a first row that is not numbers\n"
    "                               is a heading, and a heading whose first cell is \"time\"\n"
    "                               makes the first column the times (then --start and\n"
    "                               --step may be left out). Without --from every value is 0.\n"
    "  -o FILE                      the file to write (- for standard output)\n";

struct NewOptions {
    std::string kind;
    std::vector<std::string> items;
    std::string start;
    std::string step;
    long long steps = -1;
    long long points = 0;
    std::string grid, origin, cellSize;
    long long nodes = 0, elements = 0;
    std::string title;
    std::string from;
    std::string output;
};

bool EqualsNoCase(const std::string& a, const std::string& b) {
    return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) {
               return std::tolower(static_cast<unsigned char>(x)) ==
                      std::tolower(static_cast<unsigned char>(y));
           });
}

std::optional<double> Number(std::string s) {
    while (!s.empty() && std::isspace(static_cast<unsigned char>(s.back())))
        s.pop_back();
    std::size_t b = 0;
    while (b < s.size() && std::isspace(static_cast<unsigned char>(s[b])))
        ++b;
    if (b < s.size() && s[b] == '+')
        ++b;
    double v = 0;
    const auto r = std::from_chars(s.data() + b, s.data() + s.size(), v);
    if (b == s.size() || r.ec != std::errc() || r.ptr != s.data() + s.size())
        return std::nullopt;
    return v;
}

// "a,b" as two numbers.
bool Pair(const std::string& text, double& a, double& b) {
    const std::size_t comma = text.find(',');
    if (comma == std::string::npos)
        return false;
    const auto x = Number(text.substr(0, comma));
    const auto y = Number(text.substr(comma + 1));
    if (!x || !y)
        return false;
    a = *x;
    b = *y;
    return true;
}

const CLI::Validator kNotEmpty(
    [](std::string& value) { return value.empty() ? std::string("must not be empty") : std::string(); },
    "FILE");

int Fail(const std::string& message) {
    std::cerr << "mudsetup: " << message << "\n";
    return kExitError;
}

std::optional<datafile::Item> ParseItem(const std::string& arg, std::string& error) {
    std::vector<std::string> parts;
    std::size_t pos = 0;
    for (;;) {
        const std::size_t colon = arg.find(':', pos);
        parts.push_back(arg.substr(pos, colon == std::string::npos ? std::string::npos : colon - pos));
        if (colon == std::string::npos)
            break;
        pos = colon + 1;
    }
    if (parts.size() < 2 || parts.size() > 3 || parts[0].empty()) {
        error = "--item " + arg + ": expected NAME:UNITTYPE or NAME:UNITTYPE:UNIT";
        return std::nullopt;
    }
    const QuantityInfo* q = nullptr;
    long code = 0;
    const auto r = std::from_chars(parts[1].data(), parts[1].data() + parts[1].size(), code);
    if (r.ec == std::errc() && r.ptr == parts[1].data() + parts[1].size())
        q = CUnitUtil::FindQuantity(code);
    else
        for (const QuantityInfo& info : CUnitUtil::Quantities())
            if (EqualsNoCase(info.name, parts[1]))
                q = &info;
    if (!q) {
        error = "--item " + arg + ": unknown unit type \"" + parts[1] + "\"";
        return std::nullopt;
    }
    datafile::Item item{parts[0], q->code, q->units.front().name};
    if (parts.size() == 3) {
        const auto u = std::find_if(q->units.begin(), q->units.end(),
                                    [&](const UnitInfo& ui) { return parts[2] == ui.name; });
        if (u == q->units.end()) {
            std::string known;
            for (const UnitInfo& ui : q->units)
                known += (known.empty() ? "" : ", ") + std::string(ui.name);
            error = "--item " + arg + ": \"" + parts[2] + "\" is not a unit of " + q->name + " (" +
                    known + ")";
            return std::nullopt;
        }
        item.unit = u->name;
    }
    return item;
}

// The values of a CSV file (see the help); times are filled when it has a time column.
struct Csv {
    std::vector<std::vector<double>> rows;
    std::vector<double> times;  // seconds since 1970, one per row, when there is a time column
    std::vector<int> lines;
};

std::optional<Csv> ReadCsv(const std::string& path, std::string& error) {
    std::string text;
    if (const auto failure = fileio::ReadWholeFile(path, fileio::kCsvFiles, text)) {
        error = path + ": " + failure->Text();
        return std::nullopt;
    }
    std::istringstream in(std::move(text));
    Csv csv;
    bool timeColumn = false, first = true;
    std::string line;
    for (int number = 1; std::getline(in, line); ++number) {
        if (!line.empty() && line.back() == '\r')
            line.pop_back();
        const std::size_t hash = line.find('#');
        if (hash != std::string::npos)
            line.erase(hash);
        // Cells are split at commas, semicolons or tabs where the line has them, else at blanks.
        const bool delimited = line.find_first_of(",;\t") != std::string::npos;
        std::vector<std::pair<std::string, int>> cells;
        std::size_t i = 0;
        while (i <= line.size()) {
            std::size_t j = delimited ? line.find_first_of(",;\t", i) : line.find_first_of(" ", i);
            if (j == std::string::npos)
                j = line.size();
            std::string cell = line.substr(i, j - i);
            const std::size_t b = cell.find_first_not_of(' ');
            if (b == std::string::npos)
                cell.clear();
            else
                cell = cell.substr(b, cell.find_last_not_of(' ') - b + 1);
            if (delimited || !cell.empty())
                cells.emplace_back(cell, static_cast<int>(i) + 1);
            i = j + 1;
        }
        if (cells.empty() || (cells.size() == 1 && cells[0].first.empty()))
            continue;
        if (first) {
            first = false;
            const bool heading = std::any_of(cells.begin(), cells.end(), [&](const auto& c) {
                return !Number(c.first) && !datafile::ParseDateTime(c.first);
            });
            if (heading) {
                timeColumn = EqualsNoCase(cells[0].first, "time");
                continue;
            }
        }
        std::vector<double> row;
        for (std::size_t c = 0; c < cells.size(); ++c) {
            // A time in a blank-separated file spans two cells.
            if (timeColumn && c == 0) {
                std::string text = cells[0].first;
                if (!delimited && cells.size() > 1 && !datafile::ParseDateTime(text) &&
                    datafile::ParseDateTime(text + " " + cells[1].first)) {
                    text += " " + cells[1].first;
                    ++c;
                }
                if (const auto t = datafile::ParseDateTime(text))
                    csv.times.push_back(static_cast<double>(*t));
                else if (const auto s = Number(text))
                    csv.times.push_back(*s);
                else {
                    error = path + ":" + std::to_string(number) + ":" + std::to_string(cells[0].second) +
                            ": \"" + text + "\" is neither a date and time nor a number of seconds";
                    return std::nullopt;
                }
                continue;
            }
            const auto v = Number(cells[c].first);
            if (!v) {
                error = path + ":" + std::to_string(number) + ":" + std::to_string(cells[c].second) +
                        ": \"" + cells[c].first + "\" is not a number";
                return std::nullopt;
            }
            row.push_back(*v);
        }
        csv.rows.push_back(std::move(row));
        csv.lines.push_back(number);
    }
    return csv;
}

int New(const NewOptions& o) {
    const auto kind = datafile::KindFromWord(o.kind);
    if (!kind)
        return Fail("unknown kind \"" + o.kind + "\" (qrd0, qrd1, qrd2, qrdu, kx0, kx2)");
    datafile::Header h;
    h.kind = *kind;
    h.kindWord = o.kind;
    h.title = o.title;
    if (o.items.empty())
        return Fail("at least one --item NAME:UNITTYPE is needed");
    for (const std::string& arg : o.items) {
        std::string error;
        const auto item = ParseItem(arg, error);
        if (!item)
            return Fail(error);
        h.items.push_back(*item);
    }
    if (o.output != "-") {
        const auto byName = datafile::KindFromExtension(o.output);
        if (byName && *byName != *kind)
            return Fail(o.output + ": the name ends in the extension of a " +
                        datafile::KindName(*byName) + ", not of a " + datafile::KindName(*kind));
    }

    auto layoutOnly = [&](datafile::Kind k, const char* option) -> std::optional<int> {
        if (*kind != k)
            return Fail(std::string(option) + " belongs to " + datafile::KindWord(k) + " files");
        return std::nullopt;
    };
    if (o.points) {
        if (auto e = layoutOnly(datafile::Kind::LineSeries, "--points"))
            return *e;
        h.points = o.points;
    }
    if (!o.grid.empty()) {
        if (auto e = layoutOnly(datafile::Kind::Grid, "--grid"))
            return *e;
        double c = 0, r = 0;
        if (!Pair(o.grid, c, r) || c != std::floor(c) || r != std::floor(r) || c < 1 || r < 1 ||
            c * r > static_cast<double>(datafile::kMaxValuesPerStep))
            return Fail("--grid " + o.grid + ": expected COLUMNS,ROWS, whole numbers of 1 or more");
        h.columns = static_cast<std::int64_t>(c);
        h.rows = static_cast<std::int64_t>(r);
    }
    if (!o.origin.empty()) {
        if (auto e = layoutOnly(datafile::Kind::Grid, "--origin"))
            return *e;
        if (!Pair(o.origin, h.x0, h.y0))
            return Fail("--origin " + o.origin + ": expected X,Y");
    }
    if (!o.cellSize.empty()) {
        if (auto e = layoutOnly(datafile::Kind::Grid, "--cell-size"))
            return *e;
        if (!Pair(o.cellSize, h.dx, h.dy))
            return Fail("--cell-size " + o.cellSize + ": expected DX,DY");
    }
    if (o.nodes || o.elements) {
        if (auto e = layoutOnly(datafile::Kind::MeshData, o.nodes ? "--nodes" : "--elements"))
            return *e;
        if (o.nodes && o.elements)
            return Fail("--nodes and --elements: the values lie either on the nodes or on the elements");
        h.location = o.nodes ? datafile::MeshLocation::Nodes : datafile::MeshLocation::Elements;
        h.count = o.nodes ? o.nodes : o.elements;
    }

    if (*kind == datafile::Kind::LineSeries && h.points == 0)
        return Fail("a line series needs --points N");
    if (*kind == datafile::Kind::Grid && h.columns == 0)
        return Fail("a 2D grid needs --grid COLUMNS,ROWS");
    if (*kind == datafile::Kind::MeshData && h.count == 0)
        return Fail("mesh data needs --nodes N or --elements N");

    std::optional<std::int64_t> start;
    if (!o.start.empty()) {
        start = datafile::ParseDateTime(o.start);
        if (!start)
            return Fail("--start " + o.start + ": expected a date and time, yyyy-MM-dd HH:mm:ss");
    }
    std::optional<double> step;
    if (!o.step.empty()) {
        step = Number(o.step);
        if (!step || !(*step > 0) || !std::isfinite(*step))
            return Fail("--step " + o.step + ": expected a number of seconds above 0");
    }

    std::vector<double> values;
    std::int64_t steps = o.steps;
    const std::int64_t perStep = std::max<std::int64_t>(h.ValuesPerStep(), 1);
    const std::size_t perRow = static_cast<std::size_t>(perStep) * h.items.size();
    if (!o.from.empty()) {
        std::string error;
        const auto csv = ReadCsv(o.from, error);
        if (!csv)
            return Fail(error);
        if (csv->rows.empty())
            return Fail(o.from + ": the file holds no values");
        for (std::size_t r = 0; r < csv->rows.size(); ++r)
            if (csv->rows[r].size() != perRow)
                return Fail(o.from + ":" + std::to_string(csv->lines[r]) + ": " +
                            std::to_string(csv->rows[r].size()) + " values where a time step holds " +
                            std::to_string(perRow));
        if (steps >= 0 && steps != static_cast<std::int64_t>(csv->rows.size()))
            return Fail("--steps " + std::to_string(steps) + ": " + o.from + " holds " +
                        std::to_string(csv->rows.size()) + " rows");
        steps = static_cast<std::int64_t>(csv->rows.size());
        if (!csv->times.empty()) {
            const double t0 = csv->times.front();
            if (!start)
                start = static_cast<std::int64_t>(std::floor(t0));
            if (!step && csv->times.size() > 1)
                step = csv->times[1] - t0;
            for (std::size_t r = 0; r < csv->times.size(); ++r) {
                const double expected = static_cast<double>(*start) + (step ? *step : 0) * static_cast<double>(r);
                if (std::fabs(csv->times[r] - expected) > 1e-6 * std::max(1.0, step ? *step : 1.0))
                    return Fail(o.from + ":" + std::to_string(csv->lines[r]) +
                                ": the times do not follow the start and step of the file");
            }
        }
        for (const auto& row : csv->rows)
            values.insert(values.end(), row.begin(), row.end());
    }
    if (!start)
        return Fail("--start is needed (or a time column in the CSV file)");
    if (!step && steps == 1)
        step = 1.0;
    if (!step)
        return Fail("--step is needed (or a time column in the CSV file)");
    if (steps < 0)
        return Fail("--steps is needed without --from");
    h.time.start = *start;
    h.time.step = *step;
    h.time.steps = steps;
    if (const std::string problem = datafile::CheckHeader(h); !problem.empty())
        return Fail(problem);
    if (o.from.empty()) {
        const double total = static_cast<double>(steps) * static_cast<double>(perRow);
        if (total > 1e8)
            return Fail("a file of " + std::to_string(static_cast<long long>(total)) +
                        " zeros is not written; give the values with --from");
        values.assign(static_cast<std::size_t>(total), 0.0);
    }
    if (o.output == "-") {
        const std::string text = datafile::FormatDataFile(h, values);
        std::fwrite(text.data(), 1, text.size(), stdout);
        return FlushStdout() ? kExitOk : kExitError;
    }
    std::string error;
    if (!datafile::WriteDataFile(o.output, h, values, &error))
        return Fail(error);
    return kExitOk;
}

int InfoPoints(const std::string& file) {
    const datafile::XyzResult r = datafile::ReadXyz(file);
    if (r.error) {
        std::cerr << r.error->ToString() << "\n";
        return kExitError;
    }
    std::cout << "kind: point file (xyz)\npoints: " << r.points.size() << "\n";
    if (!r.points.empty()) {
        auto range = [&](const char* axis, double datafile::XyzPoint::*m) {
            const auto [lo, hi] = std::minmax_element(r.points.begin(), r.points.end(),
                                                      [&](const auto& a, const auto& b) { return a.*m < b.*m; });
            std::cout << axis << ": " << (*lo).*m << " to " << (*hi).*m << "\n";
        };
        range("x", &datafile::XyzPoint::x);
        range("y", &datafile::XyzPoint::y);
        range("z", &datafile::XyzPoint::z);
        const auto named = std::count_if(r.points.begin(), r.points.end(),
                                         [](const auto& p) { return !p.name.empty(); });
        std::cout << "named: " << named << "\n";
    }
    return FlushStdout() ? kExitOk : kExitError;
}

int Info(const std::string& file, bool headerOnly) {
    if (datafile::KindFromExtension(file) == datafile::Kind::Points)
        return InfoPoints(file);
    datafile::Header h;
    if (headerOnly) {
        datafile::HeaderResult r = datafile::ReadHeader(file);
        if (r.error) {
            std::cerr << r.error->ToString() << "\n";
            return kExitError;
        }
        h = *r.header;
    } else {
        const datafile::ValuesResult r = datafile::ReadValues(file, {}, &h);
        if (r.error) {
            std::cerr << r.error->ToString() << "\n";
            return kExitError;
        }
    }
    std::ostringstream out;
    out << "kind: " << datafile::KindName(h.kind) << " (" << h.kindWord << ")\n";
    if (!h.title.empty())
        out << "title: " << h.title << "\n";
    out << "time: " << datafile::DescribeTimeAxis(h.time) << "\n";
    out << "values: " << datafile::DescribeLayout(h) << "\n";
    out << "items: " << h.items.size() << "\n";
    for (std::size_t i = 0; i < h.items.size(); ++i)
        out << "  " << i + 1 << "  " << h.items[i].name << "  "
            << datafile::DescribeUnitType(h.items[i].unitType) << "  [" << h.items[i].unit << "]\n";
    std::cout << out.str();
    return FlushStdout() ? kExitOk : kExitError;
}

}  // namespace

void AddDatafileCommands(CLI::App& app, int& status) {
    CLI::App* group = AddCommand(app, "datafile", kDatafileHelp);
    group->require_subcommand(1);

    struct InfoOptions {
        std::string file;
        bool headerOnly = false;
    };
    auto info = std::make_shared<InfoOptions>();
    CLI::App* cmdInfo = AddCommand(*group, "info", kInfoHelp);
    cmdInfo->add_option("FILE", info->file)->required()->check(kNotEmpty);
    cmdInfo->add_flag("--header-only", info->headerOnly);
    cmdInfo->callback([info, &status] { status = Info(info->file, info->headerOnly); });

    auto opts = std::make_shared<NewOptions>();
    CLI::App* cmdNew = AddCommand(*group, "new", kNewHelp);
    cmdNew->add_option("KIND", opts->kind)->required();
    cmdNew->add_option("--item", opts->items)->allow_extra_args(false);
    cmdNew->add_option("--start", opts->start);
    cmdNew->add_option("--step", opts->step);
    cmdNew->add_option("--steps", opts->steps)->check(CLI::Range(1LL, static_cast<long long>(datafile::kMaxSteps)));
    cmdNew->add_option("--points", opts->points)->check(CLI::Range(1LL, static_cast<long long>(datafile::kMaxValuesPerStep)));
    cmdNew->add_option("--grid", opts->grid);
    cmdNew->add_option("--origin", opts->origin);
    cmdNew->add_option("--cell-size", opts->cellSize);
    cmdNew->add_option("--nodes", opts->nodes)->check(CLI::Range(1LL, static_cast<long long>(datafile::kMaxValuesPerStep)));
    cmdNew->add_option("--elements", opts->elements)->check(CLI::Range(1LL, static_cast<long long>(datafile::kMaxValuesPerStep)));
    cmdNew->add_option("--title", opts->title);
    cmdNew->add_option("--from", opts->from);
    cmdNew->add_option("-o", opts->output)->required()->check(kNotEmpty);
    cmdNew->callback([opts, &status] { status = New(*opts); });
}

}  // namespace cli
