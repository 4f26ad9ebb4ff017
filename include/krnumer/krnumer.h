/* Everything that krnumer exports. */
#ifndef KRNUMER_KRNUMER_H
#define KRNUMER_KRNUMER_H

#include <krnumer/anova.h>
#include <krnumer/binding.h>
#include <krnumer/coord.h>
#include <krnumer/distributions.h>
#include <krnumer/fft.h>
#include <krnumer/filter.h>
#include <krnumer/fit_bounds.h>
#include <krnumer/gen.h>
#include <krnumer/integration.h>
#include <krnumer/interpolation.h>
#include <krnumer/linalg.h>
#include <krnumer/linear_fit.h>
#include <krnumer/measure.h>
#include <krnumer/noise.h>
#include <krnumer/nonlinear_fit.h>
#include <krnumer/peak.h>
#include <krnumer/polynomial.h>
#include <krnumer/robust_fit.h>
#include <krnumer/sigop.h>
#include <krnumer/special.h>
#include <krnumer/spectrum.h>
#include <krnumer/stat.h>
#include <krnumer/status.h>
#include <krnumer/transform.h>
#include <krnumer/types.h>
#include <krnumer/vector.h>
#include <krnumer/window.h>
#include <krnumer/zoom.h>

#endif
