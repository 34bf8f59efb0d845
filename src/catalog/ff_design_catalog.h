#ifndef REISTI_CATALOG_FF_DESIGN_CATALOG_H
#define REISTI_CATALOG_FF_DESIGN_CATALOG_H

#include <map>
#include <span>
#include <string>
#include <vector>

#include "reisti/reisti.h"

namespace reisti {

/// A two-level factorial design or a regular fraction of one. Factors are named A, B, .. H, J, .. P in order, without
/// I. The first log2(numRuns) of them are the base factors; the others are products of base factors.
struct FF_CATALOG_DESIGN {
    int numFactors = 0;
    int numRuns = 0;     ///< a power of two; 0 in the answer to a lookup that found nothing
    int resolution = 0;  ///< 0 for a full factorial
    int maxBlocks = 0;   ///< 0 when the design cannot be blocked
    /// One word for each factor that is not a base factor, in factor order: the base factors whose product it is.
    std::vector<std::string> generators;
    /// Words whose signs make the blocks, by number of blocks: the first word gives 2 blocks, the next two give 4, the
    /// next three 8, and so on up to maxBlocks.
    std::vector<std::string> blockGenerators;
};

/// All designs by number of runs, then of factors, with their words as the text that is split when a catalog is filled.
std::span<const des_FractionalFactorial> catalogRows();

/// The catalog of two-level designs for 2 to 15 factors in 4 to 128 runs.
class FFDesignCatalog {
  public:
    FFDesignCatalog();

    /// Adds all designs, unless there are any already.
    void FillFFDesignCatalog();

    /// Adds a design, in place of any that has the same key. Words are separated by blanks.
    void AddFFCatalogDesign(int numFactors, int numRuns, int resolution, int maxBlocks, const std::string& generators,
                            const std::string& blockGenerators);

    /// A copy of the design, or a design with all numbers 0 and no words when there is none.
    FF_CATALOG_DESIGN GetFFCatalogDesign(int numFactors, int numRuns) const;

  private:
    std::map<int, FF_CATALOG_DESIGN> designs_;
};

/// 1000 * numFactors + numRuns, modulo 2^32. Pairs outside the catalog can share the key of one inside.
int GetFFDesignCatalogKey(int numFactors, int numRuns);

/// Appends the words of a text, in order, to those that are there. Nothing but the blank separates words.
void FillGeneratorVector(const std::string& text, std::vector<std::string>& words);

/// Looks a design up in a new catalog; the same answer as GetFFCatalogDesign().
FF_CATALOG_DESIGN ReadCatalogFile(int numFactors, int numRuns);

}  // namespace reisti

#endif
