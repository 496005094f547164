/// \file
/// Which texts may name a package or an architecture.
#pragma once
#include <string_view>

namespace debian {

/// True for letters, digits and `- + . _`, the characters that dpkg allows in package names.
bool mayStandInPackageName(char c);
/// True for letters, digits and `-`.
bool mayStandInArchitecture(char c);

/// True if the text is one or more allowed characters, the first of them a letter or digit.
bool isPackageName(std::string_view text);
bool isArchitecture(std::string_view text);

}  // namespace debian
