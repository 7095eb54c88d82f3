#pragma once
// Decodes JPEG bytes into a Cairo image surface (opaque RGB24).
#include <cairo.h>

#include <cstddef>

namespace norvik::drawbot {

// A new surface, or null when the bytes are not a readable JPEG image.
cairo_surface_t* DecodeJpeg(unsigned char const* inData, std::size_t inSize);

}  // namespace norvik::drawbot
