// Turning a forked child into the program under test.
#pragma once

#include <string>
#include <vector>

/// The user as whom refusals are tested, since root is refused nothing.
constexpr unsigned OtherUser = 65534;

/// Becomes the program, as the other user where asked to and where this is root. Never returns.
[[noreturn]] void Become(const std::vector<std::string>& commandLine, bool asOtherUser);
