#pragma once

#include <cstdint>
#include <vector>

#include "core/views.h"
#include "effect/strips.h"
#include "ops/blur/blur_input.h"
#include "ops/dilate/disc_shape.h"
#include "ops/grow/growth_plan.h"
#include "voreleffect/VFECore.h"
#include "voreleffect/VFExport.h"

/// The operators' plans, at the level that the tests are at. They stand in the library, which does not
/// export them; the functions are none when memory ran out.
namespace vorel_test {

/// Paints what the core of the record does, a stroke, a shadow or a glow, with so many bytes of working
/// memory, so many rows at a time.
VF_API void paintWithin(int64_t workingBytes, int64_t stripRows, int type,
                        const VFontEffect::VFProperty& record,
                        const VFontEffect::VFECore::ParamPostProcessing* params);

/// Paints with all cores by turns, strips of so many rows each; false when memory ran out at once.
VF_API bool paintByTurns(const std::vector<VFontEffect::VFECore*>& cores,
                         const VFontEffect::internal::RunBitmaps& run, int64_t stripRows);

/// The rows of strips for a run, 0 for none.
VF_API int64_t rowsOfStrips(const VFontEffect::internal::RunBitmaps& run);

/// Of windows that what is wanted is cut into; 0 for no cut.
struct WindowSize {
    int width = 0;
    int height = 0;
};

/// The window's values, row after row: by each strategy of the blur, of which one asks for a radius of 1
/// to 3 and a total of 255 at most, and by the one that the plan chooses.
VF_API std::vector<uint8_t> blurredByDots(const VFontEffect::internal::BlurInput& input,
                                          const WindowSize& size = {});
VF_API std::vector<uint8_t> blurredIn16Bits(const VFontEffect::internal::BlurInput& input,
                                            const WindowSize& size = {});
VF_API std::vector<uint8_t> blurredByDifferences(const VFontEffect::internal::BlurInput& input,
                                                 const WindowSize& size = {});
VF_API std::vector<uint8_t> blurred(const VFontEffect::internal::BlurInput& input);

/// What large discs are dilated by: tiles as far as they do not give up, or squares alone.
enum class LargeDiscs { asTheyCome, bySquares };

/// The part's values, row after row: of a source dilated by a disc, or the smaller ones of that and of
/// its inverse, dilated likewise.
VF_API std::vector<uint8_t> dilated(const VFontEffect::internal::CoverageRows& source,
                                    const VFontEffect::internal::DiscShape& disc,
                                    const VFontEffect::internal::Box& part, bool andInverse,
                                    const WindowSize& size = {},
                                    LargeDiscs largeDiscs = LargeDiscs::asTheyCome);

/// All that a source has grown to, with its margin, row after row.
VF_API std::vector<uint8_t> grown(const VFontEffect::internal::GrowthInput& input,
                                  const WindowSize& size = {});

/// The first rows of a pattern laid from a corner on, pixels R, G, B, A.
VF_API std::vector<uint32_t> tiled(const VFontEffect::internal::ColourView& pattern, float scale,
                                   float opacity, int64_t width, int64_t height);

/// Values faded to the alphas of a colour of that alpha.
VF_API std::vector<uint8_t> faded(std::vector<uint8_t> values, uint32_t alpha);

/// The first operation of the level's lanes that does not what a loop over the lanes does, or null.
VF_API const char* wrongLanesOperation(uint64_t seed);

/// Asks a dilation for its second row first: a contract that is broken.
VF_API void askForRowsOutOfOrder();

/// A line of taps or pairs that is added or taken away for a result.
struct Term {
    int64_t row;  // from the result's own on
    bool isPair;
    int sign;
};

/// How the second difference of the weights is taken apart, each sign's terms as the library has them.
struct TermsOfWeights {
    int pairDistance;
    bool pairsAreDifferences;
    std::vector<Term> terms;
};
VF_API TermsOfWeights termsOf(const VFontEffect::internal::BlurWeights& weights);

}  // namespace vorel_test
