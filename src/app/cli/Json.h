// A string as a JSON string literal, for the commands' --json output.
#pragma once

#include "paramfile/ParamFile.h"

#include <cstdio>
#include <string>
#include <vector>

class CZoSEKivBase;

namespace cli {

inline std::string JsonString(const std::string& s) {
    std::string out = "\"";
    for (unsigned char c : s) {
        switch (c) {
        case '"': out += "\\\""; break;
        case '\\': out += "\\\\"; break;
        case '\n': out += "\\n"; break;
        case '\r': out += "\\r"; break;
        case '\t': out += "\\t"; break;
        default:
            if (c < 0x20) {
                char buf[8];
                std::snprintf(buf, sizeof buf, "\\u%04x", c);
                out += buf;
            } else {
                out += static_cast<char>(c);
            }
        }
    }
    return out + "\"";
}

// Messages for machines: {"severity": ..., "text": ..., and "path" and "title_path" for a
// node's message, or "file", "line" and "column" for one from reading}.
std::string JsonMessage(const char* severity, const paramfile::Diagnostic& d);
std::string JsonMessage(const char* severity, const CZoSEKivBase* node, const std::string& text);
// "[m1, m2]" with one message a line at the given indent.
std::string JsonArray(const std::vector<std::string>& items, int indent);

}  // namespace cli
