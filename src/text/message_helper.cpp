#include "text/message_helper.h"

#include <iostream>

#include "text/vni.h"

namespace kickvane::text {

std::string MessageHelper::ConvertText(std::string_view vniText) const {
    return VniToUnicodeUtf8(vniText);
}

ConsoleMessageHelper::ConsoleMessageHelper() : ConsoleMessageHelper(std::cerr) {}

ConsoleMessageHelper::ConsoleMessageHelper(std::ostream& out) : out_(out) {}

void ConsoleMessageHelper::ShowText(std::string_view text) {
    out_ << text << '\n';
    out_.flush();
}

std::string ConsoleMessageHelper::ReadWindowText(std::uintptr_t /*window*/) const {
    return {};
}

}  // namespace kickvane::text
