#include "text/vni.h"

#include <array>
#include <optional>

#include "text/utf.h"

namespace kickvane::text {
namespace {

struct ShapeMark {
    char16_t letter;
    char16_t digit;
    char16_t result;
};

// A shape mark turns a letter into another base letter.
constexpr std::array<ShapeMark, 14> kShapeMarks{{
    {u'a', u'6', u'â'},
    {u'A', u'6', u'Â'},
    {u'e', u'6', u'ê'},
    {u'E', u'6', u'Ê'},
    {u'o', u'6', u'ô'},
    {u'O', u'6', u'Ô'},
    {u'o', u'7', u'ơ'},
    {u'O', u'7', u'Ơ'},
    {u'u', u'7', u'ư'},
    {u'U', u'7', u'Ư'},
    {u'a', u'8', u'ă'},
    {u'A', u'8', u'Ă'},
    {u'd', u'9', u'đ'},
    {u'D', u'9', u'Đ'},
}};

struct ToneRow {
    char16_t letter;
    // The letter with the tones of digits 1 to 5: acute, grave, hook above, tilde, dot below.
    std::u16string_view toned;
};

constexpr std::array<ToneRow, 24> kTones{{
    {u'a', u"áàảãạ"}, {u'â', u"ấầẩẫậ"}, {u'ă', u"ắằẳẵặ"}, {u'e', u"éèẻẽẹ"}, {u'ê', u"ếềểễệ"},
    {u'i', u"íìỉĩị"}, {u'o', u"óòỏõọ"}, {u'ô', u"ốồổỗộ"}, {u'ơ', u"ớờởỡợ"}, {u'u', u"úùủũụ"},
    {u'ư', u"ứừửữự"}, {u'y', u"ýỳỷỹỵ"}, {u'A', u"ÁÀẢÃẠ"}, {u'Â', u"ẤẦẨẪẬ"}, {u'Ă', u"ẮẰẲẴẶ"},
    {u'E', u"ÉÈẺẼẸ"}, {u'Ê', u"ẾỀỂỄỆ"}, {u'I', u"ÍÌỈĨỊ"}, {u'O', u"ÓÒỎÕỌ"}, {u'Ô', u"ỐỒỔỖỘ"},
    {u'Ơ', u"ỚỜỞỠỢ"}, {u'U', u"ÚÙỦŨỤ"}, {u'Ư', u"ỨỪỬỮỰ"}, {u'Y', u"ÝỲỶỸỴ"},
}};

// The letter that `letter` followed by the mark digit `digit` stands for, if the digit is a mark
// for that letter.
std::optional<char16_t> Apply(char16_t letter, char16_t digit) {
    if (digit >= u'1' && digit <= u'5') {
        for (const ToneRow& row : kTones) {
            if (row.letter == letter) {
                return row.toned[digit - u'1'];
            }
        }
        return std::nullopt;
    }
    for (const ShapeMark& mark : kShapeMarks) {
        if (mark.letter == letter && mark.digit == digit) {
            return mark.result;
        }
    }
    return std::nullopt;
}

// One left-to-right pass. A converted letter is never the letter of the next mark in the same
// pass: the character after the mark is only looked at as a letter, so "a61" gives "â1" here and
// a tone after a shape mark is taken up by the next pass.
std::u16string ConvertPass(std::u16string_view text) {
    std::u16string out;
    out.reserve(text.size());
    bool lastWasConverted = false;
    for (const char16_t unit : text) {
        if (!out.empty() && !lastWasConverted) {
            if (const auto result = Apply(out.back(), unit)) {
                out.back() = *result;
                lastWasConverted = true;
                continue;
            }
        }
        out.push_back(unit);
        lastWasConverted = false;
    }
    return out;
}

}  // namespace

std::u16string VniToUnicode(std::u16string_view text) {
    // Two passes: shape marks first, a tone mark directly after a shape mark in the second.
    return ConvertPass(ConvertPass(text));
}

std::string VniToUnicodeUtf8(std::string_view text) {
    return Utf16ToUtf8(VniToUnicode(Utf8ToUtf16(text)));
}

}  // namespace kickvane::text
