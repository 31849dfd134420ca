#include "game/formats/json.h"

#include <exception>
#include <nlohmann/json.hpp>
#include <string>

namespace kickvane::game {

namespace {

// Objects keep the order of their keys in the file.
using Json = nlohmann::ordered_json;

struct TooDeep : std::exception {
    const char* what() const noexcept override { return "nested too deep"; }
};

// Adds the scalars below `value`; false when there are too many.
bool Flatten(const Json& value, const std::string& path, FlatValues& out) {
    if (out.size() >= kMaxValues) {
        return false;
    }
    if (value.is_object()) {
        for (const auto& [key, item] : value.items()) {
            if (!Flatten(item, JoinKey(path, key), out)) {
                return false;
            }
        }
    } else if (value.is_array()) {
        size_t index = 0;
        for (const Json& item : value) {
            if (!Flatten(item, JoinKey(path, std::to_string(index++)), out)) {
                return false;
            }
        }
    } else if (value.is_string()) {
        out.Add(path, value.get<std::string>());
    } else if (!value.is_null()) {
        out.Add(path, value.dump());
    }
    return true;
}

}  // namespace

Parsed ParseJson(std::string_view text) {
    Parsed parsed;
    // nlohmann's parser reports a fault by an exception; the depth check throws too. None leaves
    // this function.
    try {
        const Json root = Json::parse(text, [](int depth, Json::parse_event_t, Json&) {
            if (depth > kMaxNesting) {
                throw TooDeep();
            }
            return true;
        });
        if (!Flatten(root, "", parsed.values)) {
            parsed.values = {};
            parsed.fault = ParseFault::TooComplex;
            parsed.problem = "too many values";
        }
    } catch (const TooDeep& error) {
        parsed.fault = ParseFault::TooComplex;
        parsed.problem = error.what();
    } catch (const Json::parse_error& error) {
        parsed.fault = ParseFault::Syntax;
        parsed.line = LineAt(text, error.byte > 0 ? error.byte - 1 : 0);
        const std::string_view what = error.what();
        const size_t tagEnd = what.find("] ");
        parsed.problem = what.substr(tagEnd == std::string_view::npos ? 0 : tagEnd + 2);
    } catch (const Json::exception& error) {
        parsed.fault = ParseFault::Syntax;
        // "[json.exception.parse_error.101] parse error at line 1, ...": the reason without its
        // tag.
        const std::string_view what = error.what();
        const size_t tagEnd = what.find("] ");
        parsed.problem = what.substr(tagEnd == std::string_view::npos ? 0 : tagEnd + 2);
    } catch (const std::exception& error) {
        parsed.fault = ParseFault::Syntax;
        parsed.problem = error.what();
    }
    return parsed;
}

}  // namespace kickvane::game
