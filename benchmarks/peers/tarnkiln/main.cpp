/// \file
/// Runs workloads on libraries of the given size and prints a line for each figure: whether it is
/// ours or the floor, the name of the workload, and the nanoseconds, or bytes, of one operation.
/// Usage: books_of_tarnkiln BOOKS [NAME...]
#include "benchmarks/peers/tarnkiln/Workloads.h"

#include <cstdio>
#include <cstdlib>

int main(int count, char** arguments)
{
    if (count < 2)
    {
        std::fputs("usage: books_of_tarnkiln BOOKS [NAME...]\n", stderr);
        return 2;
    }
    peers::Measure const measure(std::strtoul(arguments[1], nullptr, 10),
                                 {arguments + 2, arguments + count});
    {
        peers::FullLibraries libraries(measure.size());
        peers::measureAccess(measure, libraries);
        peers::measureGenerated(measure, libraries);
        peers::measureQueries(measure, libraries);
        peers::measureRecording(measure, libraries);
        peers::measureMoves(measure, libraries);
    }
    peers::measureProxies(measure);
    peers::measureCreation(measure);  // last: what it frees lies scattered
    peers::measureDeletion(measure);
}
