// Status codes as the library's own code names them; what each says stands beside its value in the public header.
#pragma once

#include <cstdint>

#include "krnumer/status.h"

namespace krnumer {

inline constexpr std::int32_t kOk = KRN_OK;

inline constexpr std::int32_t kOutOfMemory = KRN_OUT_OF_MEMORY;
inline constexpr std::int32_t kSizesDiffer = KRN_SIZES_DIFFER;
inline constexpr std::int32_t kEmptyInput = KRN_EMPTY_INPUT;
inline constexpr std::int32_t kNegativeLength = KRN_NEGATIVE_LENGTH;
inline constexpr std::int32_t kNoSample = KRN_NO_SAMPLE;
inline constexpr std::int32_t kFewerThanTwo = KRN_FEWER_THAN_TWO;
inline constexpr std::int32_t kFewerThanThree = KRN_FEWER_THAN_THREE;
inline constexpr std::int32_t kBadDimension = KRN_BAD_DIMENSION;
inline constexpr std::int32_t kTooLong = KRN_TOO_LONG;
inline constexpr std::int32_t kBadDuty = KRN_BAD_DUTY;
inline constexpr std::int32_t kBadCycles = KRN_BAD_CYCLES;
inline constexpr std::int32_t kBadWidth = KRN_BAD_WIDTH;
inline constexpr std::int32_t kPulseDoesNotFit = KRN_PULSE_DOES_NOT_FIT;
inline constexpr std::int32_t kBadSamplingInterval = KRN_BAD_SAMPLING_INTERVAL;
inline constexpr std::int32_t kBadIndex = KRN_BAD_INDEX;
inline constexpr std::int32_t kCutoffAboveNyquist = KRN_CUTOFF_ABOVE_NYQUIST;
inline constexpr std::int32_t kBadOrder = KRN_BAD_ORDER;
inline constexpr std::int32_t kBadDecimation = KRN_BAD_DECIMATION;
inline constexpr std::int32_t kBadFrequency = KRN_BAD_FREQUENCY;
inline constexpr std::int32_t kBadRipple = KRN_BAD_RIPPLE;
inline constexpr std::int32_t kBadAttenuation = KRN_BAD_ATTENUATION;
inline constexpr std::int32_t kZeroSigma = KRN_ZERO_SIGMA;
inline constexpr std::int32_t kBadFinalValue = KRN_BAD_FINAL_VALUE;
inline constexpr std::int32_t kAttenuationBelowRipple = KRN_ATTENUATION_BELOW_RIPPLE;
inline constexpr std::int32_t kBadBands = KRN_BAD_BANDS;
inline constexpr std::int32_t kBadRank = KRN_BAD_RANK;
inline constexpr std::int32_t kEvenLength = KRN_EVEN_LENGTH;
inline constexpr std::int32_t kMixedSigns = KRN_MIXED_SIGNS;
inline constexpr std::int32_t kUnderdetermined = KRN_UNDERDETERMINED;
inline constexpr std::int32_t kInnerSizesDiffer = KRN_INNER_SIZES_DIFFER;
inline constexpr std::int32_t kNotSquare = KRN_NOT_SQUARE;
inline constexpr std::int32_t kSingular = KRN_SINGULAR;
inline constexpr std::int32_t kTooFewLevels = KRN_TOO_FEW_LEVELS;
inline constexpr std::int32_t kBadLevel = KRN_BAD_LEVEL;
inline constexpr std::int32_t kEmptyCell = KRN_EMPTY_CELL;
inline constexpr std::int32_t kBadDataCount = KRN_BAD_DATA_COUNT;
inline constexpr std::int32_t kHistoryTooSmall = KRN_HISTORY_TOO_SMALL;
inline constexpr std::int32_t kUnbalanced = KRN_UNBALANCED;
inline constexpr std::int32_t kNoFreedomLeft = KRN_NO_FREEDOM_LEFT;
inline constexpr std::int32_t kRepeatedAbscissa = KRN_REPEATED_ABSCISSA;
inline constexpr std::int32_t kInterpolantPole = KRN_INTERPOLANT_POLE;
inline constexpr std::int32_t kBadFreedom = KRN_BAD_FREEDOM;
inline constexpr std::int32_t kBadProbability = KRN_BAD_PROBABILITY;
inline constexpr std::int32_t kTableTooSmall = KRN_TABLE_TOO_SMALL;
inline constexpr std::int32_t kNegativeCell = KRN_NEGATIVE_CELL;
inline constexpr std::int32_t kNegativeState = KRN_NEGATIVE_STATE;
inline constexpr std::int32_t kZeroBase = KRN_ZERO_BASE;
inline constexpr std::int32_t kBadSelector = KRN_BAD_SELECTOR;
inline constexpr std::int32_t kNoConvergence = KRN_NO_CONVERGENCE;
inline constexpr std::int32_t kBadCoefficient = KRN_BAD_COEFFICIENT;
inline constexpr std::int32_t kNoState = KRN_NO_STATE;
inline constexpr std::int32_t kBadCoefficientCount = KRN_BAD_COEFFICIENT_COUNT;
inline constexpr std::int32_t kNotFinite = KRN_NOT_FINITE;
inline constexpr std::int32_t kTooFewForGaussian = KRN_TOO_FEW_FOR_GAUSSIAN;
inline constexpr std::int32_t kPencilSizesDiffer = KRN_PENCIL_SIZES_DIFFER;
inline constexpr std::int32_t kNotPositiveDefinite = KRN_NOT_POSITIVE_DEFINITE;
inline constexpr std::int32_t kReorderingFailed = KRN_REORDERING_FAILED;
inline constexpr std::int32_t kReorderingIllConditioned = KRN_REORDERING_ILL_CONDITIONED;
inline constexpr std::int32_t kTooManyTaps = KRN_TOO_MANY_TAPS;
inline constexpr std::int32_t kOutputFull = KRN_OUTPUT_FULL;
inline constexpr std::int32_t kNotProvided = KRN_NOT_PROVIDED;
inline constexpr std::int32_t kNoSpread = KRN_NO_SPREAD;
inline constexpr std::int32_t kNegativeOrder = KRN_NEGATIVE_ORDER;
inline constexpr std::int32_t kHoldsNaN = KRN_HOLDS_NA_N;
inline constexpr std::int32_t kZeroPolynomial = KRN_ZERO_POLYNOMIAL;
inline constexpr std::int32_t kNoChannel = KRN_NO_CHANNEL;
inline constexpr std::int32_t kNotPositive = KRN_NOT_POSITIVE;
inline constexpr std::int32_t kZeroParameter = KRN_ZERO_PARAMETER;

inline constexpr std::int32_t kTooFewTransitions = KRN_TOO_FEW_TRANSITIONS;
inline constexpr std::int32_t kFlatHistogram = KRN_FLAT_HISTOGRAM;
inline constexpr std::int32_t kTooFewCrossings = KRN_TOO_FEW_CROSSINGS;
inline constexpr std::int32_t kMeasurementOutOfMemory = KRN_MEASUREMENT_OUT_OF_MEMORY;
inline constexpr std::int32_t kNoSamples = KRN_NO_SAMPLES;
inline constexpr std::int32_t kLevelsOutOfOrder = KRN_LEVELS_OUT_OF_ORDER;
inline constexpr std::int32_t kBadUnits = KRN_BAD_UNITS;
inline constexpr std::int32_t kBadMeasurementInterval = KRN_BAD_MEASUREMENT_INTERVAL;
inline constexpr std::int32_t kBadStateMethod = KRN_BAD_STATE_METHOD;
inline constexpr std::int32_t kNoBins = KRN_NO_BINS;
inline constexpr std::int32_t kResultNotFinite = KRN_RESULT_NOT_FINITE;
inline constexpr std::int32_t kNoPeriod = KRN_NO_PERIOD;
inline constexpr std::int32_t kUnknownContext = KRN_UNKNOWN_CONTEXT;
inline constexpr std::int32_t kBadOccurrence = KRN_BAD_OCCURRENCE;
inline constexpr std::int32_t kAlreadyPresent = KRN_ALREADY_PRESENT;
inline constexpr std::int32_t kUnexpectedKind = KRN_UNEXPECTED_KIND;
inline constexpr std::int32_t kZeroTransition = KRN_ZERO_TRANSITION;
inline constexpr std::int32_t kExceptionCaught = KRN_EXCEPTION_CAUGHT;
inline constexpr std::int32_t kNullMarkers = KRN_NULL_MARKERS;
inline constexpr std::int32_t kNullResult = KRN_NULL_RESULT;
inline constexpr std::int32_t kNullRecord = KRN_NULL_RECORD;
inline constexpr std::int32_t kLapackError = KRN_LAPACK_ERROR;

inline constexpr std::int32_t kWarnRankDeficient = KRN_WARN_RANK_DEFICIENT;
inline constexpr std::int32_t kWarnEmptyPolynomial = KRN_WARN_EMPTY_POLYNOMIAL;
inline constexpr std::int32_t kWarnZeroPivot = KRN_WARN_ZERO_PIVOT;
inline constexpr std::int32_t kWarnSizesDiffer = KRN_WARN_SIZES_DIFFER;
inline constexpr std::int32_t kWarnNotReordered = KRN_WARN_NOT_REORDERED;
inline constexpr std::int32_t kWarnInaccurate = KRN_WARN_INACCURATE;
inline constexpr std::int32_t kWarnInitialIgnored = KRN_WARN_INITIAL_IGNORED;
inline constexpr std::int32_t kWarnInitialNotFinite = KRN_WARN_INITIAL_NOT_FINITE;

}  // namespace krnumer
