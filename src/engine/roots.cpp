#include "engine/roots.h"

#include "platform/filesystem.h"

namespace kickvane::engine {

const fs::path& Roots::Of(Root root) const {
    switch (root) {
        case Root::Data:
            return data;
        case Root::ZData:
            return zdata;
        case Root::ToolData:
            return toolData;
        case Root::ToolZData:
            return toolZData;
        case Root::Extras:
            break;
    }
    return extras;
}

fs::path Roots::Resolve(const Location& location) const {
    return platform::ResolveCaseInsensitive(JoinWindowsPath(Of(location.root), location.relative));
}

fs::path JoinWindowsPath(const fs::path& folder, std::string_view relative) {
    fs::path joined = folder;
    size_t start = 0;
    while (start <= relative.size()) {
        size_t end = relative.find_first_of("\\/", start);
        if (end == std::string_view::npos) {
            end = relative.size();
        }
        if (end > start) {
            joined /= platform::PathFromUtf8(relative.substr(start, end - start));
        }
        start = end + 1;
    }
    return joined;
}

Roots ResolveRoots(const fs::path& toolFolder, std::string_view gameFolder) {
    const std::string game(gameFolder);
    return Roots{
        platform::NativePathFromUserText(game + "\\data2"),
        platform::NativePathFromUserText(game + "\\zdata\\data2"),
        JoinWindowsPath(toolFolder, "\\data\\data2"),
        JoinWindowsPath(toolFolder, "\\data\\zdata\\data2"),
        JoinWindowsPath(toolFolder, "\\extras"),
    };
}

std::string_view RootName(Root root) {
    switch (root) {
        case Root::Data:
            return "DataRoot";
        case Root::ZData:
            return "ZDataRoot";
        case Root::ToolData:
            return "ToolDataRoot";
        case Root::ToolZData:
            return "ToolZDataRoot";
        case Root::Extras:
            break;
    }
    return "ExtrasFolder";
}

RootProblem CheckRoots(const Roots& roots) {
    const fs::path toolData = platform::ResolveCaseInsensitive(roots.toolData);
    if (!platform::IsDirectory(toolData)) {
        return platform::IsTooLong(toolData) ? RootProblem::ToolDataTooLong
                                             : RootProblem::ToolDataMissing;
    }
    const fs::path data = platform::ResolveCaseInsensitive(roots.data);
    if (!platform::IsDirectory(data)) {
        return platform::IsTooLong(data) ? RootProblem::DataTooLong : RootProblem::DataMissing;
    }
    return RootProblem::None;
}

}  // namespace kickvane::engine
