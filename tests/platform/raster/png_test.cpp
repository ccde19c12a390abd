#include "platform/raster/png.h"

#include <gtest/gtest.h>
#include <png.h>

#include <array>
#include <filesystem>

namespace frontpanels {
namespace {

// Two rows of two pixels in rows of three, as a bitmap's rows may be longer than it is wide.
constexpr std::array<std::uint32_t, 6> kPixels{0xFF0000, 0x00FF00, 0x999999, 0x0000FF, 0x123456, 0x999999};
constexpr PixelView kView{kPixels.data(), 3, {2, 2}};

TEST(Png, APictureComesBackPixelByPixel) {
  std::vector<std::uint8_t> png;
  std::string error;
  ASSERT_TRUE(encodePng(kView, png, error)) << error;
  png_image image{};
  image.version = PNG_IMAGE_VERSION;
  ASSERT_NE(png_image_begin_read_from_memory(&image, png.data(), png.size()), 0);
  image.format = PNG_FORMAT_RGB;
  ASSERT_EQ(PNG_IMAGE_SIZE(image), 12U);
  std::array<std::uint8_t, 12> bytes{};
  ASSERT_NE(png_image_finish_read(&image, nullptr, bytes.data(), 0, nullptr), 0);
  const std::array<std::uint8_t, 12> expected{255, 0, 0, 0, 255, 0, 0, 0, 255, 0x12, 0x34, 0x56};
  EXPECT_EQ(bytes, expected);
}

TEST(Png, WhatCannotBeWrittenIsNamed) {
  std::vector<std::uint8_t> png{1, 2};
  std::string error;
  EXPECT_FALSE(encodePng({}, png, error));
  EXPECT_EQ(error, "The picture has no pixels.");
  EXPECT_TRUE(png.empty());
  EXPECT_FALSE(writePng("/no such folder/a.png", kView, error));
  EXPECT_EQ(error, "The file \"/no such folder/a.png\" cannot be opened for writing.");
  if (!std::filesystem::exists("/dev/full")) GTEST_SKIP() << "no device that is always full";
  EXPECT_FALSE(writePng("/dev/full", kView, error));
  EXPECT_EQ(error, "The file \"/dev/full\" could not be written wholly.");
}

}  // namespace
}  // namespace frontpanels
