#include "game/formats/vdf.h"

#include <optional>
#include <string>
#include <vector>

namespace kickvane::game {

Parsed ParseVdf(std::string_view text) {
    Parsed parsed;
    std::vector<std::string> path;
    std::optional<std::string> pendingKey;
    size_t pos = 0;
    auto fail = [&](const std::string& what) {
        parsed.values = {};
        parsed.fault = what == "too many values" ? ParseFault::TooComplex : ParseFault::Syntax;
        parsed.line = LineAt(text, pos);
        parsed.problem = "offset " + std::to_string(pos) + ": " + what;
        return parsed;
    };
    while (pos < text.size()) {
        const char c = text[pos];
        if (c == ' ' || c == '\t' || c == '\r' || c == '\n') {
            ++pos;
        } else if (c == '/' && text.substr(pos, 2) == "//") {
            pos = text.find('\n', pos);
            pos = pos == std::string_view::npos ? text.size() : pos;
        } else if (c == '{') {
            if (!pendingKey || path.size() >= static_cast<size_t>(kMaxNesting)) {
                return fail("'{' without a key");
            }
            path.push_back(std::move(*pendingKey));
            pendingKey.reset();
            ++pos;
        } else if (c == '}') {
            if (path.empty() || pendingKey) {
                return fail("unexpected '}'");
            }
            path.pop_back();
            ++pos;
        } else if (c == '"') {
            std::string token;
            ++pos;
            while (pos < text.size() && text[pos] != '"') {
                if (text[pos] == '\\' && pos + 1 < text.size()) {
                    const char e = text[++pos];
                    token += e == 'n' ? '\n' : (e == 't' ? '\t' : e);
                } else {
                    token += text[pos];
                }
                ++pos;
            }
            if (pos >= text.size()) {
                return fail("unterminated string");
            }
            ++pos;
            if (!pendingKey) {
                pendingKey = std::move(token);
            } else if (parsed.values.size() >= kMaxValues) {
                return fail("too many values");
            } else {
                std::string key;
                for (const std::string& part : path) {
                    key = JoinKey(key, part);
                }
                parsed.values.Add(JoinKey(key, *pendingKey), std::move(token));
                pendingKey.reset();
            }
        } else {
            return fail("unexpected character");
        }
    }
    if (!path.empty() || pendingKey) {
        return fail("unexpected end");
    }
    return parsed;
}

}  // namespace kickvane::game
