/// \file
/// The language of the code that began a transaction.
#pragma once

namespace tarn::kiln::meta {

enum class Language : int
{
    Unknown = 0,
    CPlusPlus = 1,
    JavaScript = 2
};
}  // namespace tarn::kiln::meta
