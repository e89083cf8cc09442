// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/atanpi.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::atanpi_d;
using scalar::atanpi_s;
using scalar::tier;

/// The points of atan: of the steps, and the numbers next to the exact results.
constexpr point_of<std::uint32_t> atanpi_s_la_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000000},
    {0x80000003, 0x80000001}, {0x00800000, 0x0028be61}, {0x3f800000, 0x3e800001},
    {0x3f7fffff, 0x3e7ffffd}, {0x3f800001, 0x3e800002}, {0xbf800000, 0xbe800001},
    {0xbf800001, 0xbe800002}, {0x40fc0000, 0x3eeb6a3c}, {0x40fbffff, 0x3eeb6a3c},
    {0x40fc0001, 0x3eeb6a3c}, {0x40f80000, 0x3eeb1629}, {0xc0fc0000, 0xbeeb6a3c},
    {0x3e000000, 0x3d22223b}, {0x3e000001, 0x3d22223c}, {0x3ec00000, 0x3de9e1d0},
    {0x71800000, 0x3f000000}, {0xff000000, 0xbf000000}, {0x7ed55555, 0x3f000000},
    {0x7f7fffff, 0x3f000000}, {0x3a83126f, 0x39a6e2cf}, {0xbf89f302, 0xbe861817},
    {0x3e0f2262, 0x3d351233}, {0xbedd859b, 0xbe051930}, {0x3ead438b, 0x3dd4b869},
    {0x3ed550d1, 0x3e00ac1d}, {0xc098b61e, 0xbede5622}, {0xc1bdb6ba, 0xbef921b2},
    {0x3fe4387a, 0x3eacb252}, {0xbf7131bc, 0xbe764beb}, {0xbf8d253c, 0xbe87f420},
    {0x428a314f, 0x3efda43a}, {0xbdbfc8e4, 0xbcf37a53}, {0x3fe289a4, 0x3eac2e50},
    {0xbd985891, 0xbcc19dc5}, {0x30935b8c, 0x2fbb9f1b}, {0x4d3bd08f, 0x3f000000},
    {0x46e9d1a8, 0x3efffe9b}, {0x2d3f1514, 0x2c734b27},
};

constexpr point_of<std::uint32_t> atanpi_s_ep_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000000},
    {0x80000003, 0x80000001}, {0x00800000, 0x0028bd00}, {0x3f800000, 0x3e800581},
    {0x3f7fffff, 0x3e800581}, {0x3f800001, 0x3e7ff4ff}, {0xbf800000, 0xbe800581},
    {0xbf800001, 0xbe7ff4ff}, {0x40fc0000, 0x3eeb69b3}, {0x40fbffff, 0x3eeb69b3},
    {0x40fc0001, 0x3eeb69b3}, {0x40f80000, 0x3eeb15a2}, {0xc0fc0000, 0xbeeb69b3},
    {0x3e000000, 0x3d22268b}, {0x3e000001, 0x3d22268c}, {0x3ec00000, 0x3de9db4c},
    {0x71800000, 0x3f000000}, {0xff000000, 0xbf000000}, {0x7ed55555, 0x3f000000},
    {0x7f7fffff, 0x3f000000}, {0x3a83126f, 0x39a6dd7c}, {0xbf89f302, 0xbe861c24},
    {0x3e0f2262, 0x3d351603}, {0xbedd859b, 0xbe0517c7}, {0x3ead438b, 0x3dd4b135},
    {0x3ed550d1, 0x3e00aa0b}, {0xc098b61e, 0xbede567b}, {0xc1bdb6ba, 0xbef92190},
    {0x3fe4387a, 0x3eacafb6}, {0xbf7131bc, 0xbe7645a7}, {0xbf8d253c, 0xbe87f8e5},
    {0x428a314f, 0x3efda440}, {0xbdbfc8e4, 0xbcf3827f}, {0x3fe289a4, 0x3eac2b9e},
    {0xbd985891, 0xbcc1a427}, {0x30935b8c, 0x2fbb98c5}, {0x4d3bd08f, 0x3f000000},
    {0x46e9d1a8, 0x3efffe9b}, {0x2d3f1514, 0x2c7342ef},
};

constexpr point_of<std::uint64_t> atanpi_d_la_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000000}, {0x8000000000000003, 0x8000000000000001},
    {0x0010000000000000, 0x000517cc1b727221}, {0x3ff0000000000000, 0x3fd0000000000000},
    {0x3fefffffffffffff, 0x3fd0000000000000}, {0x3ff0000000000001, 0x3fd0000000000000},
    {0xbff0000000000000, 0xbfd0000000000000}, {0xbff0000000000001, 0xbfd0000000000000},
    {0x401f800000000000, 0x3fdd6d477e9378dd}, {0x401f7fffffffffff, 0x3fdd6d477e9378dd},
    {0x401f800000000001, 0x3fdd6d477e9378dd}, {0x401f000000000000, 0x3fdd62c524c0866e},
    {0xc01f800000000000, 0xbfdd6d477e9378dd}, {0x3fc0000000000000, 0x3fa4444750777669},
    {0x3fc0000000000001, 0x3fa444475077766a}, {0x3fd8000000000000, 0x3fbd3c3a482f3ab6},
    {0x4630000000000000, 0x3fe0000000000000}, {0xc7e0000000000000, 0xbfe0000000000000},
    {0x47daaaaaaaaaaaab, 0x3fe0000000000000}, {0x7fefffffffffffff, 0x3fe0000000000000},
    {0x3f50624dd2f1a9fc, 0x3f34dc5a186ef309}, {0x3fdc0000ffffffff, 0x3fc0cd9959f3f49b},
    {0x3fdc000100000000, 0x3fc0cd9959f3f49c}, {0x3fe60000ffffffff, 0x3fc88a1699123919},
    {0x3fe6000100000000, 0x3fc88a169912391a}, {0x3ff30000ffffffff, 0x3fd1bdeda80edbe8},
    {0x3ff3000100000000, 0x3fd1bdeda80edbe9}, {0x40038000ffffffff, 0x3fd811a41dca8e91},
    {0x4003800100000000, 0x3fd811a41dca8e91}, {0x002fffffffffffff, 0x00145f306dc9c882},
    {0x0030000000000000, 0x00145f306dc9c883}, {0x7dffffffffffffff, 0x3fe0000000000000},
    {0x7e00000000000000, 0x3fe0000000000000}, {0x47f0000000000000, 0x3fe0000000000000},
    {0xc7f8000000000000, 0xbfe0000000000000}, {0x4800000000000000, 0x3fe0000000000000},
    {0xbff13e6048a32eb9, 0xbfd0c302d69250d2}, {0x3fc1e44c3be18663, 0x3fa6a24629faaae3},
    {0xbfdbb0b36e34a110, 0xbfc0a32617c928db}, {0x3fd5a871566e5e8b, 0x3fba970d0f467f99},
    {0x3fdaaa1a1ee8d06c, 0x3fc01583b3c6573e}, {0xc01316c3ba323c44, 0xbfdbcac4368cd1e5},
    {0xc037b6d73b35b5fb, 0xbfdf243645f06e78}, {0x3ffc870f32cca4e8, 0x3fd5964a59613b76},
    {0xbfee263770fb4ec9, 0xbfcec97d7411845a}, {0xbff1a4a7721af3d4, 0xbfd0fe83cfd2f576},
    {0x40514629e2a460ed, 0x3fdfb48735c2c26a}, {0xbfb7f91c8e04b6e3, 0xbf9e6f4a8deb1a4b},
    {0x3ffc513478db5c0b, 0x3fd585ca2e84a397}, {0xbfb30b122b683c2d, 0xbf9833b8ce590dfd},
    {0x3e126b718e240e26, 0x3df773e3a4a1f460}, {0x41a77a11dbd61ecc, 0x3fdffffffe43b756},
    {0x40dd3a350b521635, 0x3fdfffd364273d32}, {0x3da7e2a28d0d83de, 0x3d8e696521433a0c},
};

constexpr point_of<std::uint32_t> atanpi_s_nearest[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000000},
    {0x80000003, 0x80000001}, {0x00800000, 0x0028be61}, {0x3f800000, 0x3e800000},
    {0x3f7fffff, 0x3e7fffff}, {0x3f800001, 0x3e800001}, {0xbf800000, 0xbe800000},
    {0xbf800001, 0xbe800001}, {0x40fc0000, 0x3eeb6a3c}, {0x40fbffff, 0x3eeb6a3c},
    {0x40fc0001, 0x3eeb6a3c}, {0x40f80000, 0x3eeb1629}, {0xc0fc0000, 0xbeeb6a3c},
    {0x3e000000, 0x3d22223b}, {0x3e000001, 0x3d22223c}, {0x3ec00000, 0x3de9e1d2},
    {0x71800000, 0x3f000000}, {0xff000000, 0xbf000000}, {0x7ed55555, 0x3f000000},
    {0x7f7fffff, 0x3f000000}, {0x3a83126f, 0x39a6e2d1}, {0xbf8ba009, 0xbe87132b},
    {0xc03e1af0, 0xbecb1374}, {0xbead4d81, 0xbdd4c3ca}, {0xbff17ad8, 0xbeb0908c},
    {0xc09663c6, 0xbeddd4ee}, {0xbea3721a, 0xbdc9707f}, {0x40721fa7, 0x3ed5e26e},
    {0x3fb086cc, 0x3e99c0ed}, {0x3f8cb1f7, 0x3e87b1c6}, {0xbf98b18b, 0xbe8e4cf4},
    {0x3deced6c, 0x3d162a47}, {0xbf5828a3, 0xbe648fa1}, {0xbfd41bcf, 0xbea782c4},
    {0xc0384fd1, 0xbec9882d}, {0xd027be6e, 0xbf000000}, {0x4b738972, 0x3effffff},
    {0x32d5c9af, 0x32081a00}, {0xc3d941c6, 0xbeff9ffb},
};

constexpr point_of<std::uint64_t> atanpi_d_nearest[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000000}, {0x8000000000000003, 0x8000000000000001},
    {0x0010000000000000, 0x000517cc1b727221}, {0x3ff0000000000000, 0x3fd0000000000000},
    {0x3fefffffffffffff, 0x3fcfffffffffffff}, {0x3ff0000000000001, 0x3fd0000000000001},
    {0xbff0000000000000, 0xbfd0000000000000}, {0xbff0000000000001, 0xbfd0000000000001},
    {0x401f800000000000, 0x3fdd6d477e9378dd}, {0x401f7fffffffffff, 0x3fdd6d477e9378dd},
    {0x401f800000000001, 0x3fdd6d477e9378dd}, {0x401f000000000000, 0x3fdd62c524c0866e},
    {0xc01f800000000000, 0xbfdd6d477e9378dd}, {0x3fc0000000000000, 0x3fa4444750777668},
    {0x3fc0000000000001, 0x3fa444475077766a}, {0x3fd8000000000000, 0x3fbd3c3a482f3ab5},
    {0x4630000000000000, 0x3fe0000000000000}, {0xc7e0000000000000, 0xbfe0000000000000},
    {0x47daaaaaaaaaaaab, 0x3fe0000000000000}, {0x7fefffffffffffff, 0x3fe0000000000000},
    {0x3f50624dd2f1a9fc, 0x3f34dc5a186ef309}, {0x3fdc0000ffffffff, 0x3fc0cd9959f3f49b},
    {0x3fdc000100000000, 0x3fc0cd9959f3f49b}, {0x3fe60000ffffffff, 0x3fc88a1699123919},
    {0x3fe6000100000000, 0x3fc88a1699123919}, {0x3ff30000ffffffff, 0x3fd1bdeda80edbe9},
    {0x3ff3000100000000, 0x3fd1bdeda80edbe9}, {0x40038000ffffffff, 0x3fd811a41dca8e91},
    {0x4003800100000000, 0x3fd811a41dca8e91}, {0x002fffffffffffff, 0x00145f306dc9c882},
    {0x0030000000000000, 0x00145f306dc9c883}, {0x7dffffffffffffff, 0x3fe0000000000000},
    {0x7e00000000000000, 0x3fe0000000000000}, {0x47f0000000000000, 0x3fe0000000000000},
    {0xc7f8000000000000, 0xbfe0000000000000}, {0x4800000000000000, 0x3fe0000000000000},
    {0x3fda008c035d77fc, 0x3fbf7266f6475523}, {0x3fee5dceba1d73e5, 0x3fceeedc086d3ba7},
    {0x3ff550ed7797e5d7, 0x3fd2e1ffdf7607f1}, {0x4015cbb54f7c4fd0, 0x3fdc4d6e32bfe086},
    {0x3fee020144cee70e, 0x3fceb102e501bfad}, {0x401004edd387809b, 0x3fdb03dd6b489a64},
    {0xc025b53ccf4f960e, 0xbfde20ddc3598548}, {0xbfbbbde14bef39f9, 0xbfa1979f864114e9},
    {0x4016269101fc6767, 0x3fdc5c462099cc5a}, {0x3fe02a678f9c57c0, 0x3fc30f1f96cff97a},
    {0x4008ce64dac445a4, 0x3fd9a506168abb33}, {0xc0057f44ebc152e9, 0xbfd8be05510a4b71},
    {0xbfb8f127a6a8b268, 0xbf9fa840c0e69eef}, {0xbff055c975d3d60e, 0xbfd0360bb6119be2},
    {0x401520c064a3dcfd, 0x3fdc3031ec4061a0}, {0xbe83b2e7bd2f78bd, 0xbe6914d38c51113a},
    {0xc1f177a9ab7f42d9, 0xbfdfffffffed56f0}, {0x3e2cf796715d82b6, 0x3e1270e8e43eaa77},
};

TEST(AtanpiFloat, Points) {
  expect_near_points<atanpi_s<tier::ha>>(atanpi_s_nearest, 1);
  expect_points<atanpi_s<tier::la>>(atanpi_s_la_points);
  expect_points<atanpi_s<tier::ep>>(atanpi_s_ep_points);
}

TEST(AtanpiDouble, Points) {
  expect_near_points<atanpi_d<tier::ha>>(atanpi_d_nearest, 1);
  expect_points<atanpi_d<tier::la>>(atanpi_d_la_points);
  expect_near_points<atanpi_d<tier::ep>>(atanpi_d_nearest, 30'000'000);
}

TEST(AtanpiFloat, Digest) {
  EXPECT_EQ(digest<atanpi_s<tier::la>>(1e-3), 0x9149889b0bca212bu);
  EXPECT_EQ(digest<atanpi_s<tier::ep>>(1e-3), 0x8f0df496f62bc369u);
}
TEST(AtanpiDouble, Digest) { EXPECT_EQ(digest<atanpi_d<tier::la>>(1e-3), 0xc07171de5058a987u); }

template <typename Body>
class Atanpi : public ::testing::Test {};
using all_bodies = ::testing::Types<atanpi_s<tier::ha>, atanpi_s<tier::la>, atanpi_s<tier::ep>,
                                    atanpi_d<tier::ha>, atanpi_d<tier::la>, atanpi_d<tier::ep>>;
TYPED_TEST_SUITE(Atanpi, all_bodies);

TYPED_TEST(Atanpi, Specials) {
  using T = typename TypeParam::input_type;
  const T infinity = std::numeric_limits<T>::infinity();
  expect_number<TypeParam>(T(0), T(0));
  expect_number<TypeParam>(-T(0), -T(0));
  expect_number<TypeParam>(infinity, T(0.5));
  expect_number<TypeParam>(-infinity, T(-0.5));
  expect_number<TypeParam>(std::numeric_limits<T>::max(), T(0.5));
  expect_quiet_nans<TypeParam>();
}

/// Denormal results are within one number of the exact ones, and 1 is a quarter.
TEST(AtanpiDouble, Ends) {
  expect_number<atanpi_d<tier::ha>>(1.0, 0.25);
  expect_v11<atanpi_d<tier::ha>>(0x0000000000000001, 0x0000000000000000);
  expect_v11<atanpi_d<tier::ha>>(0x8000000000000002, 0x8000000000000001);
  expect_v11<atanpi_d<tier::ha>>(0x0000000000000016, 0x0000000000000007);
  EXPECT_NE(atanpi_d<tier::ha>::main(0x1.8p-901).rare, 0u);
  EXPECT_EQ(atanpi_d<tier::ha>::main(0x1p-900).rare, 0u);
}

}  // namespace
