/// \file
/// Visibility of what the exception library shares with all others.
#pragma once

#define BEDROCK_EXCEPT_EXPORT __attribute__((visibility("default")))
