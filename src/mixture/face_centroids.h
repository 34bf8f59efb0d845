#ifndef REISTI_MIXTURE_FACE_CENTROIDS_H
#define REISTI_MIXTURE_FACE_CENTROIDS_H

#include <vector>

#include "matrix/matrix_library.h"

namespace reisti {

/// Appends the centroids of the region's faces to its vertices: edges first, then faces of each higher dimension below
/// `degree`, the region itself last.
///
/// A face of dimension d is looked for wherever q-1-d planes hold at d+1 vertices or more; its centroid is the mean of
/// these vertices. Within a dimension, faces come in the lexicographic order of the planes by which they were found
/// first; a centroid near an earlier one is dropped.
///
/// The time is about that of the faces and their vertices, not of all sets of planes.
/// @param slack        [numVertices][numPlanes] values of the planes at the vertices
/// @param numCentroids out: centroids of the dimensions that were completed
/// @param points       [numVertices][q] the vertices; centroids are appended
/// @param pointTypes   entries of the vertices; those of the centroids become the dimension + 1, 0 for the region
/// itself
/// @param maxPoints    most rows that points may get
/// @return false when one more point was found; the rows up to the limit stay in points
bool mCalculateCentroidsControl(int numPlanes, int& numCentroids, int degree, int q, int numVertices,
                                const qan::matrix_library::matrix<double>& slack,
                                qan::matrix_library::matrix<double>& points, std::vector<int>& pointTypes,
                                int maxPoints);

}  // namespace reisti

#endif
