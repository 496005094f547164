// Tells whether this machine can run programs under the thread sanitizer, which wants the address
// space laid out in a way that not every kernel and container grants.
#include <atomic>
#include <thread>

int main()
{
    std::atomic<int> count = 0;
    std::thread other([&] { ++count; });
    ++count;
    other.join();
    return count == 2 ? 0 : 1;
}
