#include <ass/ass.h>

#include <cstdio>
#include <cstdlib>
#include <string>

#include "font_face.h"
#include "peers.h"
#include "workload.h"

/// libass through its public interface: ass_render_frame of one line. A figure holds shaping, loading
/// and stroking the outlines, rasterising and blurring, since its caches are emptied before each call;
/// the images that it returns are not merged or blended.
namespace vorel_bench {
namespace {

constexpr char kLibass[] = "libass";

/// Its blur of 1 has a sigma of 2 / sqrt(ln 256) pixels; the library's radius is 3.0349 sigma.
constexpr double kBlurPerRadius = 1.17741 / 3.0349;

/// The size by which libass knows a font is its ascender and descender together.
double assFontSize(const Workload& workload) {
    const FontFace font(workload.font, workload.sizePx);
    const FT_Face face = font.face();
    return static_cast<double>(workload.sizePx) * (face->ascender - face->descender) /
           face->units_per_EM;
}

std::string scriptOf(const Workload& workload, int width, int height, const std::string& tags) {
    char head[1024];
    std::snprintf(head, sizeof head,
                  "[Script Info]\nScriptType: v4.00+\nPlayResX: %d\nPlayResY: %d\n"
                  "ScaledBorderAndShadow: yes\nWrapStyle: 2\n\n"
                  "[V4+ Styles]\nFormat: Name, Fontname, Fontsize, PrimaryColour, OutlineColour, "
                  "BorderStyle, Outline, Shadow, Alignment\n"
                  "Style: Default,Face,%.4f,&H00FFFFFF,&H00000000,1,0,0,5\n\n"
                  "[Events]\nFormat: Layer, Start, End, Style, Name, MarginL, MarginR, MarginV, "
                  "Effect, Text\n"
                  "Dialogue: 0,0:00:00.00,0:00:10.00,Default,,0,0,0,,",
                  width, height, assFontSize(workload));
    return std::string(head) + "{" + tags + "}" + workload.text + "\n";
}

ASS_Library* silentLibrary() {
    ASS_Library* const library = ass_library_init();
    ass_set_message_cb(
        library, [](int, const char*, va_list, void*) {}, nullptr);
    return library;
}

class LibassJob : public Job {
  public:
    LibassJob(const Workload* workload, int margin, const std::string& tags)
        : mLibrary(silentLibrary()),
          mRenderer(ass_renderer_init(mLibrary)),
          mWidth(workload->width + 2 * margin + 16),
          mHeight(2 * workload->height + 2 * margin + 16) {
        ass_set_frame_size(mRenderer, mWidth, mHeight);
        ass_set_fonts(mRenderer, workload->font.c_str(), "Face", ASS_FONTPROVIDER_NONE, nullptr, 0);
        std::string script = scriptOf(*workload, mWidth, mHeight, tags);
        mTrack = ass_read_memory(mLibrary, script.data(), script.size(), nullptr);
        if (ass_render_frame(mRenderer, mTrack, kMoment, nullptr) == nullptr) {
            std::fprintf(stderr, "libass draws nothing of: %s\n", script.c_str());
            std::exit(1);
        }
    }

    ~LibassJob() override {
        ass_free_track(mTrack);
        ass_renderer_done(mRenderer);
        ass_library_done(mLibrary);
    }

    /// A new frame size empties the caches; it is changed there and back.
    void reset() override {
        ass_set_frame_size(mRenderer, mWidth + 1, mHeight);
        ass_set_frame_size(mRenderer, mWidth, mHeight);
    }

    void paint() override { ass_render_frame(mRenderer, mTrack, kMoment, nullptr); }

  private:
    static constexpr long long kMoment = 1000;

    ASS_Library* mLibrary;
    ASS_Renderer* mRenderer;
    ASS_Track* mTrack;
    int mWidth;
    int mHeight;
};

void addLine(Cases& cases, const std::string& row, const Workload& workload, int margin,
             const std::string& tags) {
    cases.push_back(
        caseOf<LibassJob>(row, kLibass, workload.grownPixels(margin), &workload, margin, tags));
}

}  // namespace

void addLibassCases(Cases& cases) {
    for (const Workload* workload : {&line48(), &title160()}) {
        addLine(cases, "text/plain/" + workload->name, *workload, 0, "\\bord0\\shad0");
        for (const int radius : kRadii) {
            const std::string place = workload->name + "/R:" + std::to_string(radius);
            addLine(cases, "stroke/outside/" + place, *workload, radius,
                    "\\bord" + std::to_string(radius) + "\\shad0");
            addLine(cases, "shadow/outer/" + place, *workload, radius,
                    "\\bord0\\shad0\\blur" + std::to_string(radius * kBlurPerRadius));
        }
    }
}

}  // namespace vorel_bench
