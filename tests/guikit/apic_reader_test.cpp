// Reading "APIC" resources: every header check, data that would run past the
// resource, palette limits, and which class each kind becomes.

#include <gtest/gtest.h>

#include <vector>

#include "guikit/alpha_pic_data24.h"
#include "guikit/alpha_pic_data8.h"
#include "guikit/apic_builder.h"
#include "guikit/apic_format.h"
#include "guikit/font_factory.h"
#include "guikit/multicolor_font.h"
#include "guikit/pic_data24.h"
#include "guikit/pic_data8.h"
#include "guikit/pic_data_factory.h"
#include "guikit/unicolor_font.h"

namespace {

using apic_test::ApicBuilder;
using guikit::FontFactory;
using guikit::PicDataFactory;

std::vector<uint8_t> small_alpha8() {
  return apic_test::alpha8(3, 2, {0x00112233, 0x00445566}, {{0, 255}, {1, 0}, {1, 128}, {0, 1}, {1, 2}, {0, 3}})
      .build();
}

int status_of(const std::vector<uint8_t>& bytes) {
  return guikit::read_apic_header(bytes.data(), bytes.size(), nullptr);
}

bool picture_accepted(const std::vector<uint8_t>& bytes) {
  return PicDataFactory::create_from_memory(bytes.data(), bytes.size()) != nullptr;
}

TEST(ApicReader, ReadsEveryHeaderField) {
  const auto bytes = small_alpha8();
  guikit::ApicHeader h;
  ASSERT_EQ(guikit::read_apic_header(bytes.data(), bytes.size(), &h), guikit::kApicOk);
  EXPECT_EQ(h.flag, -1);
  EXPECT_EQ(h.header_size, 36);
  EXPECT_EQ(h.kind, 1);
  EXPECT_EQ(h.bits, 8);
  EXPECT_EQ(h.width, 3);
  EXPECT_EQ(h.height, 2);
  EXPECT_EQ(h.palette_count, 2);
  EXPECT_EQ(h.palette_offset, 36);
  EXPECT_EQ(h.pixel_offset, 44);
}

TEST(ApicReader, EachHeaderCheckRefuses) {
  struct Bad {
    int field;
    int32_t value;
    int status;
  };
  const Bad cases[] = {
      {apic_test::kFlag, 0, guikit::kApicZeroFlag},
      {apic_test::kHeaderSize, 35, guikit::kApicShortHeaderSize},
      {apic_test::kHeaderSize, 1 << 20, guikit::kApicShortHeaderSize},
      {apic_test::kBits, 16, guikit::kApicBadBits},
      {apic_test::kBits, 0, guikit::kApicBadBits},
      {apic_test::kKind, 3, guikit::kApicBadBits},
      {apic_test::kWidth, -1, guikit::kApicNegativeSize},
      {apic_test::kHeight, -3, guikit::kApicNegativeSize},
      {apic_test::kPaletteCount, 257, guikit::kApicBadPaletteCount},
      {apic_test::kPaletteCount, -1, guikit::kApicBadPaletteCount},
      {apic_test::kPixelOffset, -4, guikit::kApicPixelsOutside},
      {apic_test::kPixelOffset, 45, guikit::kApicPixelsOutside},
      {apic_test::kPaletteOffset, 0, guikit::kApicPaletteOutside},
      {apic_test::kPaletteOffset, 50, guikit::kApicPaletteOutside},
      {apic_test::kPaletteOffset, -8, guikit::kApicPaletteOutside},
      {apic_test::kWidth, 4, guikit::kApicPixelsOutside},
      {apic_test::kPaletteCount, 1, guikit::kApicIndexOutsidePalette},
  };
  ASSERT_TRUE(picture_accepted(small_alpha8()));
  for (const Bad& bad : cases) {
    auto bytes = small_alpha8();
    ApicBuilder::put(&bytes, bad.field, bad.value);
    EXPECT_EQ(status_of(bytes), bad.status) << "field " << bad.field << " = " << bad.value;
    EXPECT_FALSE(picture_accepted(bytes)) << "field " << bad.field << " = " << bad.value;
    EXPECT_EQ(FontFactory::create_from_memory(bytes.data(), bytes.size()), nullptr);
  }
}

TEST(ApicReader, TruncatedDataIsRefusedAtEveryLength) {
  const auto full = small_alpha8();
  for (size_t n = 0; n < full.size(); ++n) {
    const std::vector<uint8_t> cut(full.begin(), full.begin() + static_cast<long>(n));
    EXPECT_FALSE(picture_accepted(cut)) << n << " bytes";
  }
  EXPECT_EQ(guikit::read_apic_header(nullptr, 100, nullptr), guikit::kApicTruncatedHeader);
}

TEST(ApicReader, PaletteCountLimits) {
  std::vector<uint32_t> palette(256);
  for (size_t i = 0; i < palette.size(); ++i) palette[i] = static_cast<uint32_t>(i * 0x010101);
  std::vector<uint8_t> indices = {0, 255, 17, 128};
  EXPECT_TRUE(picture_accepted(apic_test::opaque8(2, 2, palette, indices).build()));
  // An empty palette is fine only for a picture without pixels.
  EXPECT_TRUE(picture_accepted(apic_test::opaque8(0, 5, {}, {}).build()));
  EXPECT_FALSE(picture_accepted(apic_test::opaque8(1, 1, {}, {0}).build()));
  // A true-colour picture carries no palette, so its count is not looked at.
  auto bytes = apic_test::true_colour(0, 1, 1, {0x00FFFFFF}).build();
  ApicBuilder::put(&bytes, apic_test::kPaletteCount, 1000);
  EXPECT_TRUE(picture_accepted(bytes));
}

TEST(ApicReader, HugeSizesCannotWrapTheBoundsCheck) {
  const int32_t sizes[][2] = {{0x7FFFFFFF, 0x7FFFFFFF}, {0x10000, 0x10000}, {0x40000000, 4}, {0x20000001, 8}};
  for (const auto& wh : sizes) {
    for (int kind_bits = 0; kind_bits < 3; ++kind_bits) {
      auto bytes = kind_bits == 0   ? small_alpha8()
                   : kind_bits == 1 ? apic_test::true_colour(1, 3, 2, std::vector<uint32_t>(6, 0xFF000000u)).build()
                                    : apic_test::unicolor_font({2, 1}, 2, std::vector<uint8_t>(6, 9)).build();
      ApicBuilder::put(&bytes, apic_test::kWidth, wh[0]);
      ApicBuilder::put(&bytes, apic_test::kHeight, wh[1]);
      EXPECT_EQ(status_of(bytes), guikit::kApicPixelsOutside) << wh[0] << " x " << wh[1];
    }
  }
}

TEST(ApicReader, EachKindBecomesItsClass) {
  const auto opaque8 = apic_test::opaque8(1, 1, {0x00010203}, {0}).build();
  const auto opaque24 = apic_test::true_colour(0, 1, 1, {0x00010203}).build();
  const auto alpha8 = small_alpha8();
  const auto alpha24 = apic_test::true_colour(1, 1, 1, {0x80010203}).build();
  auto p8 = PicDataFactory::create_from_memory(opaque8.data(), opaque8.size());
  auto p24 = PicDataFactory::create_from_memory(opaque24.data(), opaque24.size());
  auto a8 = PicDataFactory::create_from_memory(alpha8.data(), alpha8.size());
  auto a24 = PicDataFactory::create_from_memory(alpha24.data(), alpha24.size());
  EXPECT_NE(dynamic_cast<guikit::PicData8*>(p8.get()), nullptr);
  EXPECT_NE(dynamic_cast<guikit::PicData24*>(p24.get()), nullptr);
  EXPECT_NE(dynamic_cast<guikit::AlphaPicData8*>(a8.get()), nullptr);
  EXPECT_NE(dynamic_cast<guikit::AlphaPicData24*>(a24.get()), nullptr);

  const auto uni = apic_test::unicolor_font({2, 3}, 2, std::vector<uint8_t>(10, 50)).build();
  EXPECT_FALSE(picture_accepted(uni));
  auto font = FontFactory::create_from_memory(uni.data(), uni.size());
  EXPECT_NE(dynamic_cast<guikit::UnicolorFont*>(font.get()), nullptr);
  auto multi = FontFactory::create_from_memory(alpha8.data(), alpha8.size());
  EXPECT_NE(dynamic_cast<guikit::MulticolorFont*>(multi.get()), nullptr);
  // Opaque and true-colour pictures are no fonts.
  EXPECT_EQ(FontFactory::create_from_memory(opaque8.data(), opaque8.size()), nullptr);
  EXPECT_EQ(FontFactory::create_from_memory(alpha24.data(), alpha24.size()), nullptr);
}

TEST(ApicReader, FontWithoutMarkerRowIsRefused) {
  auto bytes = apic_test::unicolor_font({2}, 1, {1, 2}).build();
  ApicBuilder::put(&bytes, apic_test::kHeight, 0);
  EXPECT_EQ(status_of(bytes), guikit::kApicOk);
  EXPECT_EQ(FontFactory::create_from_memory(bytes.data(), bytes.size()), nullptr);
}

TEST(ApicReader, MissingResourceGivesNothing) {
  EXPECT_EQ(PicDataFactory::instance().create_picture("no_such_picture_here"), nullptr);
  EXPECT_EQ(FontFactory::instance().create_font("no_such_font_here"), nullptr);
}

}  // namespace
