#include "Json.h"

#include "setupeditor/ZoSEKivBase.h"

namespace cli {

std::string JsonMessage(const char* severity, const paramfile::Diagnostic& d) {
    std::string s = std::string("{\"severity\": \"") + severity + "\", \"text\": " +
                    JsonString(d.message) + ", \"file\": " + JsonString(d.file);
    if (d.pos.line > 0)
        s += ", \"line\": " + std::to_string(d.pos.line);
    if (d.pos.line > 0 && d.pos.column > 0)
        s += ", \"column\": " + std::to_string(d.pos.column);
    return s + "}";
}

std::string JsonMessage(const char* severity, const CZoSEKivBase* node, const std::string& text) {
    // Titles from the section down, as the editor's message list names them; the module's
    // root goes without saying below it.
    std::vector<std::string> titles;
    const CZoSEKivBase* module = nullptr;
    for (const CZoSEKivBase* n = node; n && n->GetParent(); n = n->GetParent())
        module = n;
    for (const CZoSEKivBase* n = node; n && n->GetParent(); n = n->GetParent()) {
        if (n == module && n != node)
            break;
        if (!n->GetTitle().empty())
            titles.insert(titles.begin(), n->GetTitle());
    }
    std::string path = "[";
    for (size_t i = 0; i < titles.size(); ++i)
        path += (i ? ", " : "") + JsonString(titles[i]);
    path += "]";
    return std::string("{\"severity\": \"") + severity + "\", \"text\": " + JsonString(text) +
           ", \"path\": " + JsonString(node ? NodePath(node) : std::string()) +
           ", \"title_path\": " + path + "}";
}

std::string JsonArray(const std::vector<std::string>& items, int indent) {
    if (items.empty())
        return "[]";
    const std::string pad(static_cast<size_t>(indent) + 2, ' ');
    std::string s = "[";
    for (size_t i = 0; i < items.size(); ++i)
        s += (i ? ",\n" : "\n") + pad + items[i];
    return s + "\n" + std::string(static_cast<size_t>(indent), ' ') + "]";
}

}  // namespace cli
