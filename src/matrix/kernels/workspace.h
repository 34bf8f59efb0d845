// Scratch memory of one call into the kernels.
#ifndef REISTI_MATRIX_KERNELS_WORKSPACE_H
#define REISTI_MATRIX_KERNELS_WORKSPACE_H

#include <cstddef>
#include <cstdint>
#include <memory>

namespace reisti::kernels {

// A block of doubles that starts at a cache line and grows on demand, for callers that need the same scratch again and
// again. Contents are undefined after every call of reserve.
class Workspace {
  public:
    double* reserve(std::size_t count) {
        if (count > capacity_) {
            // Deliberately not set to zero: every user writes before it reads.
            storage_.reset(new double[count + kLine]);
            capacity_ = count;
        }
        const std::size_t misplaced = reinterpret_cast<std::uintptr_t>(storage_.get()) / sizeof(double) % kLine;
        return storage_.get() + (kLine - misplaced) % kLine;
    }

  private:
    static constexpr std::size_t kLine = 64 / sizeof(double);

    std::unique_ptr<double[]> storage_;
    std::size_t capacity_ = 0;
};

}  // namespace reisti::kernels

#endif
