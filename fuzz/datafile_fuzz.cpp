// Any bytes as a data file and as a point file: each reads or is refused with a place in
// the text, never crashes; what the reader accepts, the writer writes back to the same.
#include "datafile/DataFile.h"

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

namespace {

void Require(bool ok, const char* what) {
    if (!ok) {
        std::fprintf(stderr, "%s\n", what);
        std::abort();
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const datafile::HeaderResult h = datafile::ParseHeader(text, "fuzz");
    Require(h.header.has_value() != h.error.has_value(), "a header is either read or refused");
    if (h.error)
        Require(h.error->line >= 1 && h.error->column >= 1, "a refused header has a place");

    datafile::ValuesRequest request;
    request.items = {0, 1, 2};
    request.point = 1;
    datafile::Header header;
    const datafile::ValuesResult v = datafile::ParseValues(text, "fuzz", request, &header);
    Require(!h.error || v.error, "values are not read past a refused header");
    if (!v.error && static_cast<double>(header.time.steps) * static_cast<double>(header.ValuesPerStep()) *
                            static_cast<double>(header.items.size()) <= 10000) {
        // Read the values whole and write them again: the same header and values come back.
        std::vector<double> values;
        datafile::ValuesRequest all;
        for (int i = 0; i < static_cast<int>(header.items.size()); ++i)
            all.items.push_back(i);
        for (std::int64_t p = 0; p < header.ValuesPerStep(); ++p) {
            all.point = p;
            const datafile::ValuesResult part = datafile::ParseValues(text, "fuzz", all);
            Require(!part.error, "a file read once reads again");
            if (p == 0)
                values.resize(static_cast<std::size_t>(header.time.steps * header.ValuesPerStep()) *
                              header.items.size());
            for (std::size_t s = 0; s < part.rows.size(); ++s)
                for (std::size_t k = 0; k < part.rows[s].size(); ++k)
                    values[(s * header.items.size() + k) * static_cast<std::size_t>(header.ValuesPerStep()) +
                           static_cast<std::size_t>(p)] = part.rows[s][k];
        }
        const std::string written = datafile::FormatDataFile(header, values);
        datafile::Header back;
        const datafile::ValuesResult again = datafile::ParseValues(written, "fuzz", all, &back);
        Require(!again.error, "what is written reads back");
        Require(back.items.size() == header.items.size() && back.time.start == header.time.start &&
                    back.time.steps == header.time.steps &&
                    (back.time.step == header.time.step) && back.title == header.title,
                "the header reads back the same");
        Require(datafile::FormatDataFile(back, values) == written, "writing is stable");
    }

    const datafile::XyzResult p = datafile::ParseXyz(text, "fuzz.xyz");
    if (p.error)
        Require(p.points.empty() && p.error->line >= 1, "a refused point file has a place");
    return 0;
}
