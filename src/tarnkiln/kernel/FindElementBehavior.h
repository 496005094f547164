/// \file
/// How far a search for an element may go.
#pragma once

namespace tarn::kiln {

enum class FindElementBehavior : int
{
    InMemory = 0,  ///< Only what the model holds now.
    Fetch = 1      ///< The data source may load the element.
};
}  // namespace tarn::kiln
