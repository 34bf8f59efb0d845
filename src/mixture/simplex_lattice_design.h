#ifndef REISTI_MIXTURE_SIMPLEX_LATTICE_DESIGN_H
#define REISTI_MIXTURE_SIMPLEX_LATTICE_DESIGN_H

#include <cstdint>

#include "mixture/simplex_centroid_design.h"
#include "reisti/reisti.h"

namespace reisti {

/// Whether a lattice of this degree is offered for so many components.
bool isLatticeDegreeAllowed(std::uint32_t numComponents, std::int32_t degree);

/// Builds the {q, degree} simplex lattice: all mixtures whose proportions are multiples of 1/degree.
class SimplexLatticeDesign : public SimplexCentroidDesign {
  public:
    SimplexLatticeDesign(des_MixtureDesign* design, int degree, bool centerPoint);

    /// Checks the degree and then runs the steps of the base class.
    void Calculate(int& error) override;

  protected:
    void GenerateBaseDesign() override;
    void GenerateOverallCenterpoint() override;
    virtual void CheckDegree(int& error);

    std::int32_t degree_;

  private:
    bool HoldsCentroid() const;
};

}  // namespace reisti

#endif
