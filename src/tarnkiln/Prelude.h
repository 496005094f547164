/// \file
/// What most sources of the library include from outside, compiled once for all of them.
///
/// No source relies on it: each includes what it uses. Headers of our own stay out, since a change
/// of one would compile everything anew.
#pragma once
#include <boost/date_time/posix_time/ptime.hpp>
#include <boost/optional.hpp>
#include <boost/uuid/uuid.hpp>

#include <algorithm>
#include <array>
#include <atomic>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <exception>
#include <functional>
#include <initializer_list>
#include <iterator>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <sstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <tuple>
#include <type_traits>
#include <typeinfo>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>
