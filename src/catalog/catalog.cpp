#include "catalog/catalog.h"

#include <array>

namespace kickvane::catalog {

namespace {

constexpr std::array<PatchCategory, kCategoryCount> kCategories{{
    {"Bong", "Thay đổi bóng", 0, 1, GroupId::Ball},
    {"Co", "Thay đổi cỏ", 1, 1, GroupId::Pitch},
    {"Qcao", "Thay biển q.cáo", 2, 1, GroupId::Adboard},
    {"Gdien", "Thay đổi đồ hoạ ", 3, 1, std::nullopt},
    {"Logo", "Thay Logo", 4, 1, std::nullopt},
    {"Khac", "Các tuỳ chỉnh khác", 5, 1, std::nullopt},
    {"Face", "Thay đổi ngoại hình", 6, 1, std::nullopt},
    {"Giay", "Thay đổi giày", 7, 1, std::nullopt},
    {"Kit", "Thay đổi áo đấu", 8, 1, std::nullopt},
    {"Luoi", "Thay đổi lưới", 9, 1, std::nullopt},
    {"TiSo", "Thay đổi bảng tỉ số", 10, 1, GroupId::Scoreboard},
    {"Mark", "Thay đổi Mark", 11, 1, GroupId::Mark},
    {"CDV", "Thay đổi Cổ động viên", 12, 0, std::nullopt},
    {"SVD", "Thay đổi Sân vận động", 13, 0, std::nullopt},
}};

// Each variant names its set below "\extras"; the option without one restores the base set.
// The default ball is a variant, not the base set: with no settings "Europa League 2011" is on.
constexpr std::array<PatchOption, 4> kBall{{
    {"MacDinh", "Mặc định", 0, false},
    {"Europa League 2011", "Europa League 2011", 1, true, "\\Ball\\Europa League 2011"},
    {"Teamgeist Blue White", "Teamgeist Blue White", 2, false, "\\Ball\\Teamgeist Blue White"},
    {"UCL 2011", "UCL 2011", 3, false, "\\Ball\\UCL 2011"},
}};

constexpr std::array<PatchOption, 8> kScoreboard{{
    {"MacDinh", "Mặc định", 0, true},
    {"SkySportHDBlue", "Sky Sport HD Blue", 1, false, "\\scoreboard\\SkySport Blue"},
    {"ESPNHD", "ESPN HD", 2, false, "\\scoreboard\\ESPN HD"},
    {"StarSportsBlue", "Star Sports Blue", 3, false, "\\scoreboard\\StarSports Blue"},
    {"K+NS", "K+ Nhịp sống", 4, false, "\\scoreboard\\K+ NS"},
    {"VTCHDVIP", "VTC HD VIP", 5, false, "\\scoreboard\\VTC HD VIP"},
    {"VTV3UCL", "VTV3 UCL", 6, false, "\\scoreboard\\VTV3 UCL"},
    {"SSUCLRed", "Supa Strikas UCL Red", 7, false, "\\scoreboard\\SupaStrikas UCL Red"},
}};

// Adboard, pitch and mark share the row of the "Khác" tab (indices 0-10) and section "Khac".
constexpr std::array<PatchOption, 4> kAdboard{{
    {"QcaoMacDinh", "Quảng cáo mặc định", 0, true},
    {"QcaoUCL", "Quảng cáo UCL", 1, false, "\\adboard\\UCL"},
    {"QcaoVN", "Quảng cáo Việt Nam", 2, false, "\\adboard\\Viet Nam"},
    {"QcaoWC2010", "Quảng cáo WC 2010", 3, false, "\\adboard\\WC 2010"},
}};

constexpr std::array<PatchOption, 4> kPitch{{
    {"CoMacDinh", "Mặt cỏ mặc định", 4, true},
    {"CoCaro", "Mặt cỏ Caro", 5, false, "\\pitch\\Caro"},
    {"CoOvalUCL", "Mặt cỏ Oval UCL", 6, false, "\\pitch\\Oval UCL"},
    {"CoCaroUCL", "Mặt cỏ Caro UCL", 7, false, "\\pitch\\Caro UCL"},
}};

constexpr std::array<PatchOption, 3> kMark{{
    {"MarkMacDinh", "Mark mặc định", 8, true},
    {"MarkMatCuoi", "Mark Mặt cười", 9, false, "\\Indicator\\Mat cuoi"},
    {"MarkPESvang", "Mark PES (Vàng)", 10, false, "\\Indicator\\PES vang"},
}};

constexpr std::array<VariantGroup, kGroupCount> kGroups{{
    {GroupId::Ball, 0, "Bong", OptionArray::Ball, LabelArray::Ball, 1, 0, kBall},
    {GroupId::Scoreboard, 10, "Bang Ti So", OptionArray::Scoreboard, LabelArray::Scoreboard, 2, 1,
     kScoreboard},
    {GroupId::Adboard, 2, "Khac", OptionArray::Other, LabelArray::Other, 3, 2, kAdboard},
    {GroupId::Pitch, 1, "Khac", OptionArray::Other, LabelArray::Other, 3, 3, kPitch},
    {GroupId::Mark, 11, "Khac", OptionArray::Other, LabelArray::Other, 3, 4, kMark},
}};

}  // namespace

std::span<const PatchCategory> Categories() {
    return kCategories;
}

std::span<const VariantGroup> Groups() {
    return kGroups;
}

const VariantGroup& Group(GroupId id) {
    return kGroups[static_cast<size_t>(id)];
}

const VariantGroup* GroupOfOption(OptionArray array, int index) {
    for (const VariantGroup& group : kGroups) {
        if (group.array == array && index >= group.options.front().index &&
            index <= group.options.back().index) {
            return &group;
        }
    }
    return nullptr;
}

}  // namespace kickvane::catalog
