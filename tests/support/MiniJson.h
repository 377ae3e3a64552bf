// A strict little JSON reader for checking the command line's documents in tests: it
// refuses what JSON refuses (trailing commas, bare nan, unescaped control characters).
#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

namespace minijson {

struct Value {
    enum class Type { Null, Bool, Number, String, Array, Object } type = Type::Null;
    bool boolean = false;
    double number = 0;
    std::string string;
    std::vector<Value> array;
    std::map<std::string, Value> object;

    bool Has(const std::string& key) const { return object.count(key) > 0; }
    const Value& operator[](const std::string& key) const { return object.at(key); }
};

class Parser {
public:
    explicit Parser(const std::string& text) : m_s(text) {}
    // False, with the offset in error, when the text is not one JSON document.
    bool Parse(Value& out) {
        Ws();
        if (!ParseValue(out))
            return false;
        Ws();
        return m_i == m_s.size();
    }
    size_t Offset() const { return m_i; }

private:
    void Ws() {
        while (m_i < m_s.size() && (m_s[m_i] == ' ' || m_s[m_i] == '\n' || m_s[m_i] == '\t' || m_s[m_i] == '\r'))
            ++m_i;
    }
    bool Eat(char c) {
        Ws();
        if (m_i < m_s.size() && m_s[m_i] == c) {
            ++m_i;
            return true;
        }
        return false;
    }
    bool Word(const char* w) {
        const std::string word(w);
        if (m_s.compare(m_i, word.size(), word) != 0)
            return false;
        m_i += word.size();
        return true;
    }
    bool ParseString(std::string& out) {
        if (!Eat('"'))
            return false;
        while (m_i < m_s.size()) {
            const unsigned char c = static_cast<unsigned char>(m_s[m_i++]);
            if (c == '"')
                return true;
            if (c < 0x20)
                return false;
            if (c != '\\') {
                out += static_cast<char>(c);
                continue;
            }
            if (m_i >= m_s.size())
                return false;
            const char e = m_s[m_i++];
            switch (e) {
            case '"': out += '"'; break;
            case '\\': out += '\\'; break;
            case '/': out += '/'; break;
            case 'n': out += '\n'; break;
            case 't': out += '\t'; break;
            case 'r': out += '\r'; break;
            case 'b': out += '\b'; break;
            case 'f': out += '\f'; break;
            case 'u': {
                if (m_i + 4 > m_s.size())
                    return false;
                const unsigned long code = std::stoul(m_s.substr(m_i, 4), nullptr, 16);
                m_i += 4;
                if (code >= 0x80)
                    return false;  // enough for what the commands escape
                out += static_cast<char>(code);
                break;
            }
            default: return false;
            }
        }
        return false;
    }
    bool ParseValue(Value& v) {
        Ws();
        if (m_i >= m_s.size())
            return false;
        const char c = m_s[m_i];
        if (c == '{') {
            ++m_i;
            v.type = Value::Type::Object;
            if (Eat('}'))
                return true;
            do {
                std::string key;
                Ws();
                if (!ParseString(key) || !Eat(':') || !ParseValue(v.object[key]))
                    return false;
            } while (Eat(','));
            return Eat('}');
        }
        if (c == '[') {
            ++m_i;
            v.type = Value::Type::Array;
            if (Eat(']'))
                return true;
            do {
                v.array.emplace_back();
                if (!ParseValue(v.array.back()))
                    return false;
            } while (Eat(','));
            return Eat(']');
        }
        if (c == '"') {
            v.type = Value::Type::String;
            return ParseString(v.string);
        }
        if (Word("true") || Word("false")) {
            v.type = Value::Type::Bool;
            v.boolean = m_s[m_i - 1] == 'e' && m_s[m_i - 2] == 'u';
            return true;
        }
        if (Word("null"))
            return true;
        size_t used = 0;
        if (c != '-' && (c < '0' || c > '9'))
            return false;
        v.type = Value::Type::Number;
        v.number = std::stod(m_s.substr(m_i, 40), &used);
        m_i += used;
        return true;
    }

    const std::string& m_s;
    size_t m_i = 0;
};

}  // namespace minijson
