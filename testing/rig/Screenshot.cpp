#include "testing/rig/Screenshot.h"

#include <png.h>

#include "testing/rig/XcbReply.h"

namespace plume::rig {

void writeScreenshot(XClient& client, const std::filesystem::path& file) {
    const auto& screen = client.screen();
    writeScreenshot(client, file, {0, 0, screen.width_in_pixels, screen.height_in_pixels});
}

void writeScreenshot(XClient& client, const std::filesystem::path& file, const XClient::Place& part) {
    const auto width = static_cast<std::uint16_t>(part.width);
    const auto height = static_cast<std::uint16_t>(part.height);
    constexpr std::uint32_t AllPlanes = ~0U;
    const auto cookie =
        xcb_get_image(client.connection(), XCB_IMAGE_FORMAT_Z_PIXMAP, client.root(), static_cast<std::int16_t>(part.x),
                      static_cast<std::int16_t>(part.y), width, height, AllPlanes);
    const auto reply = own(xcb_get_image_reply(client.connection(), cookie, nullptr));
    constexpr int BytesPerPixel = 4;  // the server is configured with depth 24
    if (!reply || xcb_get_image_data_length(reply.get()) < width * height * BytesPerPixel) {
        throw RigError("the X server gives no picture of its screen");
    }
    auto* pixels = xcb_get_image_data(reply.get());
    for (int i = 0; i < width * height; ++i) pixels[i * BytesPerPixel + 3] = 0xFF;  // the unused byte becomes opaque

    png_image image{};
    image.version = PNG_IMAGE_VERSION;
    image.width = width;
    image.height = height;
    image.format = PNG_FORMAT_BGRA;
    if (png_image_write_to_file(&image, file.c_str(), 0, pixels, width * BytesPerPixel, nullptr) == 0) {
        throw RigError("cannot write " + file.string() + ": " + image.message);
    }
}

}  // namespace plume::rig
