#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <iostream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "tests/support/both_sets.h"
#include "tests/support/file_bytes.h"
#include "tests/support/float_states.h"
#include "tests/support/levels.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/random.h"

/// Hashes of painted scenes, which must come out equal on every compiler, optimisation level, CPU and
/// C library.
///
///     voreleffect_hashes                  prints the table
///     voreleffect_hashes --literal        the same table, painted by the literal engine
///     voreleffect_hashes --compare FILE   at every level of the instruction set that this CPU has, in
///                                         every floating-point state that a caller may be in; fails,
///                                         naming them, when lines differ from the file's
///     voreleffect_hashes --compare-literal FILE   likewise, painted by the literal engine
namespace {

using namespace vorel_test;
using literal::Engine;
using literal::Mask;
using literal::Picture;
using VFontEffect::VFEffect;

/// FNV-1a, 64 bits.
class Hash {
  public:
    void add(const std::vector<uint8_t>& bytes) {
        for (const uint8_t byte : bytes)
            mState = (mState ^ byte) * 1099511628211ULL;
    }
    std::string text() const {
        char digits[17];
        std::snprintf(digits, sizeof digits, "%016llx", static_cast<unsigned long long>(mState));
        return digits;
    }

  private:
    uint64_t mState = 14695981039346656037ULL;
};

/// A sweep paints one run for each value of its range.
template <class Set>
struct Sweep {
    const char* name;
    int first;
    int last;
    int step;
    std::function<void(Set&, Kit<Set>&, int)> add;
};

float real(int value) {
    return static_cast<float>(value);
}

/// 0 / Divisor, 1 / Divisor and so on: worked out by the compiler, as what is painted may be painted in
/// any rounding mode.
template <int Divisor>
float part(int value) {
    constexpr auto kParts = [] {
        std::array<float, 101> parts = {};
        for (size_t i = 0; i < parts.size(); ++i)
            parts[i] = static_cast<float>(i) / static_cast<float>(Divisor);
        return parts;
    }();
    return kParts.at(static_cast<size_t>(value));
}

template <class Set>
std::vector<Sweep<Set>> sweeps() {
    using K = Kit<Set>;
    return {
        {"text opacity", 0, 20, 1, [](Set& s, K&, int i) { s.setTextOpacity(part<20>(i)); }},
        {"stroke outside size", 0, 40, 1,
         [](Set& s, K&, int i) { s.addStrokeText(real(i), 0xE03020, 0.9F, 0, 1); }},
        {"stroke inside size", 0, 40, 1,
         [](Set& s, K&, int i) { s.addStrokeText(real(i), 0xE03020, 0.9F, 0, 2); }},
        {"stroke centre size", 0, 40, 1,
         [](Set& s, K&, int i) { s.addStrokeText(real(i), 0xE03020, 0.9F, 0, 0); }},
        {"outer shadow angle", 0, 359, 1,
         [](Set& s, K&, int i) { s.addOuterShadowText(real(i), 17, 2, 0x201008, 0.8F); }},
        {"outer shadow size", 0, 100, 1,
         [](Set& s, K&, int i) { s.addOuterShadowText(30, 5, real(i), 0x201008, 0.8F); }},
        {"inner shadow angle", 0, 359, 1,
         [](Set& s, K&, int i) { s.addInnerShadowText(real(i), 5, 2, 0x201008, 0.8F); }},
        {"inner shadow size", 0, 100, 1,
         [](Set& s, K&, int i) { s.addInnerShadowText(30, 3, real(i), 0x201008, 0.8F); }},
        {"outer glow size", 0, 100, 4,
         [](Set& s, K&, int i) { s.addOuterGlowText(real(i), 0xFFC000, 0.9F, 0, nullptr); }},
        {"outer glow stops size", 0, 40, 2,
         [](Set& s, K& k, int i) { s.addOuterGlowText(real(i), 0, 0.9F, 3, k.stops); }},
        {"inner glow size", 0, 100, 4,
         [](Set& s, K&, int i) { s.addInnerGlowText(real(i), 0xFFC000, 0.9F, 0, nullptr); }},
        {"linear gradient angle", 0, 359, 1,
         [](Set& s, K& k, int i) { s.addLinearGradientText(real(i), 1, 0.9F, 3, k.stops); }},
        {"linear gradient scale", 0, 40, 1,
         [](Set& s, K& k, int i) { s.addLinearGradientText(37, part<20>(i), 1, 3, k.stops); }},
        {"radial gradient scale", 0, 40, 1,
         [](Set& s, K& k, int i) { s.addRadialGradientText(part<20>(i), 0.9F, 3, k.stops); }},
        {"pattern scale", 0, 100, 1,
         [](Set& s, K& k, int i) { s.addPatternText(&k.tile, part<10>(i), 0.9F); }},
        {"all layered", 0, 10, 1,
         [](Set& s, K& k, int i) {
             s.setTextOpacity(part<20>(i));
             s.addOuterShadowText(real(40 * i), 6, 3, 0, 0.6F);
             s.addOuterGlowText(real(i), 0x00C0FF, 0.8F, 0, nullptr);
             s.addStrokeText(real(i), 0xFFFFFF, 1, 0, i % 3);
             s.addLinearGradientText(real(33 * i), 1, 0.7F, 3, k.stops);
             s.addPatternText(&k.tile, 1.5F, 0.5F);
             s.addInnerGlowText(1, 0xFFFFFF, 0.5F, 0, nullptr);
             s.addInnerShadowText(300, 2, 1, 0x400000, 0.8F);
         }},
    };
}

std::vector<NamedMask> masks() {
    Random random(7);
    return {{"disc", discMask(34, 26, 16.5F, 13.0F, 11.5F, true)},
            {"noise", noiseMask(random, 29, 17, 60)}};
}

template <class Set>
std::string hashOf(const Sweep<Set>& sweep, const Mask& mask) {
    Hash hash;
    for (int value = sweep.first; value <= sweep.last; value += sweep.step) {
        Kit<Set> kit;
        Set set;
        sweep.add(set, kit, value);
        hash.add(paintedRun(set, mask, {72, 60, 19, 15}).bytes);
    }
    return hash.text();
}

using Table = std::map<std::string, std::string>;

template <class Set>
Table tableOf(const FloatState& state = floatStates().front()) {
    Table table;
    const std::vector<NamedMask> all = masks();
    const InFloatState callers(state);
    for (const NamedMask& mask : all) {
        for (const Sweep<Set>& sweep : sweeps<Set>()) {
            table[std::string(sweep.name) + ", " + mask.name] = hashOf(sweep, mask.mask);
        }
    }
    return table;
}

std::string lines(const Table& table) {
    std::ostringstream text;
    for (const auto& [scene, hash] : table)
        text << hash << "  " << scene << '\n';
    return text.str();
}

std::string textOf(const char* path) {
    if (const auto text = bytesOfFile(path)) return *text;
    std::cerr << "cannot read " << path << '\n';
    std::exit(2);
}

/// Whether the table, painted by `painter`, is that of the file; names the lines that differ.
bool compare(const Table& table, const std::string& painter, const std::string& committed) {
    const std::string now = lines(table);
    if (now == committed) {
        std::cout << painter << ": " << table.size() << " hashes are equal\n";
        return true;
    }
    std::istringstream actual(now);
    for (std::string line; std::getline(actual, line);) {
        if (committed.find(line + '\n') == std::string::npos)
            std::cerr << painter << " differs: " << line << '\n';
    }
    return false;
}

bool compareLevels(const std::string& committed) {
    bool same = true;
    for (const CpuLevel level : levelsHere()) {
        useLevel(level);
        for (const FloatState& state : floatStates()) {
            same =
                compare(tableOf<VFEffect>(state), nameOf(level) + ", " + state.name, committed) && same;
        }
    }
    return same;
}

}  // namespace

int main(int argc, char** argv) {
    const std::string mode = argc > 1 ? argv[1] : "";
    bool same = true;
    if (argc == 3 && mode == "--compare") {
        same = compareLevels(textOf(argv[2]));
    } else if (argc == 3 && mode == "--compare-literal") {
        same = compare(tableOf<Engine>(), "the literal form", textOf(argv[2]));
    } else {
        std::cout << lines(mode == "--literal" ? tableOf<Engine>() : tableOf<VFEffect>());
    }
    return same ? 0 : 1;
}
