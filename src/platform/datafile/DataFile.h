// Data files that sections refer to by name and item numbers: time series (.qrd0, older
// .kx0), line series (.qrd1), 2D grids (.qrd2, older .kx2) and unstructured-mesh data
// (.qrdu). One text format for all of them (docs/data-files.md): a header that names the
// items with their unit types and units and gives the time axis, then the values. The
// header is read on its own, without touching the values, so that checking a large file
// costs no more than checking a small one.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace datafile {

enum class Kind { TimeSeries, LineSeries, Grid, MeshData, Points };

// "time series", "line series", "2D grid", "mesh data", "point file".
const char* KindName(Kind kind);
// The kind a file name's extension stands for (any case), if it is one of ours.
std::optional<Kind> KindFromExtension(std::string_view fileName);
// The header word of a kind ("qrd0", "qrd1", "qrd2", "qrdu"); the older words "kx0" and
// "kx2" read as time series and 2D grid.
std::optional<Kind> KindFromWord(std::string_view word);
const char* KindWord(Kind kind);

// A place in a file, 1-based; "FILE:LINE:COLUMN: message".
struct Error {
    std::string file;
    int line = 0;
    int column = 0;
    std::string message;
    std::string ToString() const;
};

struct Item {
    std::string name;
    long unitType = 0;  // the unit system's quantity code (fem/UnitUtil)
    std::string unit;   // one of that quantity's units
};

// Times are seconds since 1970-01-01 00:00:00 UTC.
struct TimeAxis {
    std::int64_t start = 0;
    double step = 0;     // seconds, > 0
    std::int64_t steps = 0;  // >= 1
    double End() const { return static_cast<double>(start) + step * static_cast<double>(steps - 1); }
};

// Where the values of one time step lie.
enum class MeshLocation { Nodes, Elements };

struct Header {
    Kind kind = Kind::TimeSeries;
    std::string kindWord;  // as written ("qrd0", "kx0", ...)
    int version = 1;
    std::string title;
    TimeAxis time;
    std::vector<Item> items;
    // Line series: points on the line. Grid: columns × rows. Mesh data: nodes or elements.
    std::int64_t points = 0;
    std::int64_t columns = 0, rows = 0;
    double x0 = 0, y0 = 0, dx = 1, dy = 1;
    MeshLocation location = MeshLocation::Nodes;
    std::int64_t count = 0;  // mesh data: nodes or elements

    // Values per item and time step (1 for a time series).
    std::int64_t ValuesPerStep() const;
    // Line on which the values start (the line after "values").
    int valuesLine = 0;
};

// Bounds that keep a corrupt header from asking for absurd amounts of anything.
constexpr int kMaxItems = 10000;
constexpr std::int64_t kMaxSteps = 1000000000;
constexpr std::int64_t kMaxValuesPerStep = 1000000000;
constexpr std::size_t kMaxHeaderLine = 65536;
constexpr std::size_t kMaxHeaderBytes = 4u << 20;

struct HeaderResult {
    std::optional<Header> header;  // set exactly when error is not
    std::optional<Error> error;
};

// Reads a file's header and stops at "values". The name's extension, when it is one of
// ours, must agree with the kind the header declares.
HeaderResult ReadHeader(const std::string& path);
// The same over text in memory (name is used in messages and for the extension check).
HeaderResult ParseHeader(std::string_view text, const std::string& name);

// What to take from the values: the items (0-based) and one point of each step (0-based;
// always 0 for a time series), at most maxSteps steps. All values are still checked.
struct ValuesRequest {
    std::vector<int> items;
    std::int64_t point = 0;
    std::int64_t maxSteps = 1000000;
    bool check = true;  // read to the end and check the number of values
    // When >= 0: every point of the first requested item at this step, into ValuesResult::field.
    std::int64_t fieldStep = -1;
};

struct ValuesResult {
    std::optional<Error> error;
    // rows[step][k] is the value of request.items[k] at request.point.
    std::vector<std::vector<double>> rows;
    std::vector<double> field;  // see ValuesRequest::fieldStep
    std::int64_t valuesRead = 0;
    double minimum = 0, maximum = 0;  // over all finite values read
};

// Reads a whole file: the header, then the values as requested.
ValuesResult ReadValues(const std::string& path, const ValuesRequest& request,
                        Header* header = nullptr);
ValuesResult ParseValues(std::string_view text, const std::string& name,
                         const ValuesRequest& request, Header* header = nullptr);

// Checks a header for writing: the message of its first fault, or empty.
std::string CheckHeader(const Header& header);
// The file as text; values are step by step, item by item, point by point.
std::string FormatDataFile(const Header& header, const std::vector<double>& values);
// Writes beside the target and renames over it only when the whole write succeeded.
bool WriteDataFile(const std::string& path, const Header& header,
                   const std::vector<double>& values, std::string* error);

// "25 time steps of 1 h from 2024-01-01 00:00:00 to 2024-01-02 00:00:00".
std::string DescribeTimeAxis(const TimeAxis& time);
// Where a step's values lie: "one value per item and step", "4 points on the line",
// "3 x 2 cells from (0, 0), cells of 10 x 10", "120 nodes of the mesh".
std::string DescribeLayout(const Header& header);
// "Wave height (100084)"; the code alone where the unit system does not know it.
std::string DescribeUnitType(long unitType);

// "yyyy-MM-dd HH:mm:ss" (a 'T' may stand for the space; the seconds may be left off) as
// seconds since 1970-01-01 00:00:00 UTC.
std::optional<std::int64_t> ParseDateTime(std::string_view text);
std::string FormatDateTime(std::int64_t seconds);
// A number of seconds as "30 s", "1.5 h", "2 days" for messages.
std::string FormatDuration(double seconds);

// A point file: lines "x y z name", the name optional.
struct XyzPoint {
    double x = 0, y = 0, z = 0;
    std::string name;
};
struct XyzResult {
    std::vector<XyzPoint> points;
    std::optional<Error> error;
};
XyzResult ReadXyz(const std::string& path);
XyzResult ParseXyz(std::string_view text, const std::string& name);

}  // namespace datafile
