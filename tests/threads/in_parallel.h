#ifndef REISTI_TESTS_THREADS_IN_PARALLEL_H
#define REISTI_TESTS_THREADS_IN_PARALLEL_H

#include <atomic>
#include <cstddef>
#include <thread>
#include <vector>

namespace reisti::test {

inline constexpr std::size_t THREADS = 8;

/// Calls work(number) for all numbers below count, dealt in turn to eight threads that start at the same moment.
template <typename Work>
void inParallel(std::size_t count, Work work) {
    std::atomic<bool> start = false;
    std::vector<std::thread> threads;
    for (std::size_t t = 0; t < THREADS; ++t) {
        threads.emplace_back([&, t] {
            while (!start) {
                std::this_thread::yield();
            }
            for (std::size_t i = t; i < count; i += THREADS) {
                work(i);
            }
        });
    }
    start = true;
    for (std::thread& thread : threads) {
        thread.join();
    }
}

}  // namespace reisti::test

#endif
