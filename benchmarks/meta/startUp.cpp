// How long the first use of the metamodel takes, in a process that has done nothing else.
#include "benchmarks/support/LiveBytes.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/MetaRegistry.h"

#include <chrono>
#include <iostream>

namespace {

/// Microseconds and bytes of `firstUse`.
template <class FirstUse> void measure(char const* what, FirstUse const& firstUse)
{
    std::size_t const before = benchkit::liveBytes();
    auto const begin = std::chrono::steady_clock::now();
    firstUse();
    std::chrono::duration<double, std::micro> const time = std::chrono::steady_clock::now() - begin;
    std::cout << what << ' ' << time.count() << ' ' << benchkit::liveBytes() - before << '\n';
}
}  // namespace

int main()
{
    using namespace tarn::kiln;
    measure("registry", [] { meta::MetaRegistry::getInstance(); });
    measure("catalogue", [] { meta::Class::metaClass(); });
}
