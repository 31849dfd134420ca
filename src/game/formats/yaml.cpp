#include "game/formats/yaml.h"

#include <yaml-cpp/yaml.h>

#include <exception>
#include <string>

namespace kickvane::game {

namespace {

// Adds the scalars below `node`; false when the tree is too deep or too large.
bool Flatten(const YAML::Node& node, const std::string& path, int depth, FlatValues& out) {
    if (depth > kMaxNesting || out.size() >= kMaxValues) {
        return false;
    }
    switch (node.Type()) {
        case YAML::NodeType::Scalar:
            out.Add(path, node.Scalar());
            return true;
        case YAML::NodeType::Sequence: {
            size_t index = 0;
            for (const YAML::Node& item : node) {
                if (!Flatten(item, JoinKey(path, std::to_string(index++)), depth + 1, out)) {
                    return false;
                }
            }
            return true;
        }
        case YAML::NodeType::Map:
            for (const auto& pair : node) {
                // Only scalar keys name anything a manager's code looks for.
                if (pair.first.IsScalar() &&
                    !Flatten(pair.second, JoinKey(path, pair.first.Scalar()), depth + 1, out)) {
                    return false;
                }
            }
            return true;
        case YAML::NodeType::Null:
        case YAML::NodeType::Undefined:
            return true;
    }
    return true;
}

}  // namespace

Parsed ParseYaml(std::string_view text) {
    Parsed parsed;
    if (text.find('\0') != std::string_view::npos) {
        parsed.fault = ParseFault::NotText;
        parsed.problem = "not a text file";
        return parsed;
    }
    // yaml-cpp reports every fault by an exception; none leaves this function.
    try {
        const YAML::Node root = YAML::Load(std::string(text));
        if (!root.IsNull() && !root.IsMap()) {
            parsed.fault = ParseFault::NotMapping;
            parsed.problem = "not a mapping of keys";
            return parsed;
        }
        if (!Flatten(root, "", 0, parsed.values)) {
            parsed.values = {};
            parsed.fault = ParseFault::TooComplex;
            parsed.problem = "nested too deep or too many values";
        }
    } catch (const YAML::Exception& error) {
        parsed.values = {};
        parsed.fault = ParseFault::Syntax;
        parsed.line = error.mark.is_null() ? 0 : static_cast<size_t>(error.mark.line) + 1;
        parsed.problem = error.mark.is_null()
                             ? error.msg
                             : "line " + std::to_string(error.mark.line + 1) + ": " + error.msg;
    } catch (const std::exception& error) {
        parsed.values = {};
        parsed.fault = ParseFault::Syntax;
        parsed.problem = error.what();
    }
    return parsed;
}

}  // namespace kickvane::game
