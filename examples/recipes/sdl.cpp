// A line of text in SDL 2: onto a surface, and as a texture that moves over other drawings.
#include <SDL.h>

#include <algorithm>
#include <cstdlib>
#include <optional>
#include <vector>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

/// For surfaces of the formats RGBA32 and BGRA32, which name the bytes as they lie in memory. ARGB8888
/// and XRGB8888, the formats of most windows, are BGRA there.
PictureView viewOf(SDL_Surface& surface) {
    const bool isRgba = surface.format->format == SDL_PIXELFORMAT_RGBA32;
    return {static_cast<unsigned char*>(surface.pixels), surface.w, surface.h, surface.pitch,
            isRgba ? PixelOrder::rgba : PixelOrder::bgra};
}

bool paintOn(SDL_Surface& surface, const Look& look, Glyphs glyphs, int x, int y) {
    if (SDL_MUSTLOCK(&surface)) SDL_LockSurface(&surface);
    const bool isPainted = paint(look, glyphs, viewOf(surface), x, y).has_value();
    if (SDL_MUSTLOCK(&surface)) SDL_UnlockSurface(&surface);
    return isPainted;
}

/// Divides the alpha out.
std::vector<unsigned char> straight(const Picture& picture) {
    std::vector<unsigned char> pixels(picture.data(),
                                      picture.data() + picture.stride() * picture.height());
    for (std::size_t i = 0; i < pixels.size(); i += 4)
        for (std::size_t channel = i; pixels[i + 3] > 0 && channel < i + 3; ++channel)
            pixels[channel] = static_cast<unsigned char>(
                std::min(255, (pixels[channel] * 255 + pixels[i + 3] / 2) / pixels[i + 3]));
    return pixels;
}

/// Premultiplied where the renderer can blend so. SDL's software renderer cannot: it gets straight
/// pixels.
SDL_Texture* textureOf(SDL_Renderer* renderer, const Picture& picture) {
    SDL_Texture* texture = SDL_CreateTexture(renderer, SDL_PIXELFORMAT_RGBA32, SDL_TEXTUREACCESS_STATIC,
                                             picture.width(), picture.height());
    if (texture == nullptr) return nullptr;
    const SDL_BlendMode premultiplied = SDL_ComposeCustomBlendMode(
        SDL_BLENDFACTOR_ONE, SDL_BLENDFACTOR_ONE_MINUS_SRC_ALPHA, SDL_BLENDOPERATION_ADD,
        SDL_BLENDFACTOR_ONE, SDL_BLENDFACTOR_ONE_MINUS_SRC_ALPHA, SDL_BLENDOPERATION_ADD);
    if (SDL_SetTextureBlendMode(texture, premultiplied) == 0) {
        SDL_UpdateTexture(texture, nullptr, picture.data(), picture.stride());
    } else {
        SDL_UpdateTexture(texture, nullptr, straight(picture).data(), picture.stride());
        SDL_SetTextureBlendMode(texture, SDL_BLENDMODE_BLEND);
    }
    return texture;
}

/// Draws the picture with the origin of its text at (x, y).
void draw(SDL_Renderer* renderer, SDL_Texture* texture, const Picture& picture, int x, int y) {
    const SDL_Rect place = {x + picture.left(), y + picture.top(), picture.width(), picture.height()};
    SDL_RenderCopy(renderer, texture, nullptr, &place);
}

/// A surface of the format that SDL_GetWindowSurface gives.
SDL_Surface* windowSurface() {
    SDL_Surface* surface = SDL_CreateRGBSurfaceWithFormat(0, 420, 120, 32, SDL_PIXELFORMAT_XRGB8888);
    check(surface != nullptr, "a surface");
    SDL_FillRect(surface, nullptr, SDL_MapRGB(surface->format, 0x17, 0x2A, 0x54));
    return surface;
}

/// The surface holds what a page does; what was blended from straight pixels was rounded twice.
void checkSeen(const PictureView& seen, const Look& look, const Line& line) {
    Page page(seen.width, seen.height, 0x172A54);
    paint(look, line.glyphs, page.view(), 30, 85);
    paint(look, line.glyphs, page.view(), 230, 85);
    for (int y = 0; y < seen.height; ++y)
        for (int x = 0; x < seen.width; ++x)
            for (int channel = 0; channel < 3; ++channel) {
                const int painted = page.view().data[(y * seen.width + x) * 4 + channel];
                const int drawn = seen.data[y * seen.stride + x * 4 + 2 - channel];
                check(std::abs(drawn - painted) <= (x < 200 ? 0 : 2), "as on a page");
            }
}

}  // namespace

int main(int, char**) {
    const Line line = Font(kFont, 72).line("SDL");
    Look look;
    look.fill(rgb(0xF4F7FF))
        .add(OuterGlow(14, rgb(0x3BD1FF)))
        .add(InnerShadow(rgb(0x1B4B8F)).angle(270).distance(3).size(5).opacity(0.9F));

    SDL_Surface* surface = windowSurface();
    check(paintOn(*surface, look, line.glyphs, 30, 85), "painted on the surface");
    SDL_Renderer* renderer = SDL_CreateSoftwareRenderer(surface);
    const std::optional<Picture> picture = paint(look, line.glyphs);
    check(renderer != nullptr && picture, "a renderer and a picture");
    SDL_Texture* texture = textureOf(renderer, *picture);
    check(texture != nullptr, "a texture");
    draw(renderer, texture, *picture, 230, 85);
    SDL_RenderPresent(renderer);

    checkSeen(viewOf(*surface), look, line);
    Page page(surface->w, surface->h, 0);
    SDL_ConvertPixels(surface->w, surface->h, surface->format->format, surface->pixels, surface->pitch,
                      SDL_PIXELFORMAT_RGBA32, page.view().data, 4 * surface->w);
    check(page.writePng("sdl.png"), "a PNG");
    SDL_DestroyTexture(texture);
    SDL_DestroyRenderer(renderer);
    SDL_FreeSurface(surface);
    return 0;
}
