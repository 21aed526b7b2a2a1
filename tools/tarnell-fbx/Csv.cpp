// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Csv.h"

namespace tool {

std::string csvField(const std::string& text) {
    if (text.find_first_of(",\"\r\n") == std::string::npos)
        return text;
    std::string field = "\"";
    for (const char character : text)
        field += character == '"' ? std::string("\"\"") : std::string(1, character);
    return field + '"';
}

} // namespace tool
