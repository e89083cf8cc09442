// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/atan.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::atan_d;
using scalar::atan_d_nolut;
using scalar::atan_s;
using scalar::tier;

/// Zeros, denormals, 1, 7.875, the thresholds of the segments and of the rare path with their
/// neighbours, the largest number, and random arguments.
constexpr point_of<std::uint32_t> atan_s_ha_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000003, 0x80000003}, {0x00800000, 0x00800000}, {0x3f800000, 0x3f490fda},
    {0x3f7fffff, 0x3f490fda}, {0x3f800001, 0x3f490fdc}, {0xbf800000, 0xbf490fda},
    {0xbf800001, 0xbf490fdc}, {0x40fc0000, 0x3fb8e4fd}, {0x40fbffff, 0x3fb8e4fd},
    {0x40fc0001, 0x3fb8e4fd}, {0x40f80000, 0x3fb8a2f5}, {0xc0fc0000, 0xbfb8e4fd},
    {0x3e000000, 0x3dfeadd5}, {0x3e000001, 0x3dfeadd7}, {0x3ec00000, 0x3eb7b0ca},
    {0x71800000, 0x3fc90fdb}, {0xff000000, 0xbfc90fdb}, {0x7ed55555, 0x3fc90fdb},
    {0x7f7fffff, 0x3fc90fdb}, {0x3a83126f, 0x3a83126c}, {0x3ff05fa5, 0x3f8a6e16},
    {0x3f8673b7, 0x3f4f5aa4}, {0xbe826926, 0xbe7f6416}, {0xbf71dbcf, 0xbf41cad8},
    {0x3d1111dc, 0x3d110258}, {0xbe9d8afa, 0xbe98d5e2}, {0x3f9e64c0, 0x3f6420f0},
    {0xbf35d581, 0xbf1e1ae8}, {0xbd96c51a, 0xbd967f9a}, {0x3e89337a, 0x3e860d38},
    {0x40570000, 0x3fa4075b}, {0x3c7122e2, 0x3c711e6d}, {0xbf5127c9, 0xbf2f5e12},
    {0x3f84a5a6, 0x3f4da02b}, {0x3479529d, 0x3479529d}, {0x52a1872d, 0x3fc90fdb},
    {0x4f3319c4, 0x3fc90fdb}, {0xc7fe2451, 0xbfc90f9a},
};

constexpr point_of<std::uint32_t> atan_s_la_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000003, 0x80000003}, {0x00800000, 0x00800000}, {0x3f800000, 0x3f490fdc},
    {0x3f7fffff, 0x3f490fd9}, {0x3f800001, 0x3f490fde}, {0xbf800000, 0xbf490fdc},
    {0xbf800001, 0xbf490fde}, {0x40fc0000, 0x3fb8e4fe}, {0x40fbffff, 0x3fb8e4fe},
    {0x40fc0001, 0x3fb8e4fe}, {0x40f80000, 0x3fb8a2f6}, {0xc0fc0000, 0xbfb8e4fe},
    {0x3e000000, 0x3dfeadd6}, {0x3e000001, 0x3dfeadd8}, {0x3ec00000, 0x3eb7b0c9},
    {0x71800000, 0x3fc90fdb}, {0xff000000, 0xbfc90fdb}, {0x7ed55555, 0x3fc90fdb},
    {0x7f7fffff, 0x3fc90fdb}, {0x3a83126f, 0x3a83126b}, {0xc00e47dd, 0xbf92f4d2},
    {0x3ff5f3d4, 0x3f8ba3fc}, {0x3f8b781c, 0x3f54085a}, {0xbf77c7b8, 0xbf44e2a6},
    {0xbc6adc8b, 0xbc6ad86c}, {0xbe23c7a9, 0xbe226789}, {0x3f03fa69, 0x3ef3b689},
    {0x3fa38086, 0x3f68165f}, {0xc0523abb, 0xbfa33c68}, {0xc131ae07, 0xbfbd910c},
    {0x3fe162b6, 0x3f86f362}, {0xbe5b72ab, 0xbe582d98}, {0x3f8a297a, 0x3f52d4cd},
    {0xc306f661, 0xbfc81d11}, {0xc6b8a44f, 0xbfc90e78}, {0xd0d5ad3b, 0xbfc90fdb},
    {0x2c8c1c01, 0x2c8c1c00}, {0xc116eb94, 0xbfbb8ad8},
};

constexpr point_of<std::uint32_t> atan_s_ep_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000003, 0x80000003}, {0x00800000, 0x007ffbac}, {0x3f800000, 0x3f491881},
    {0x3f7fffff, 0x3f491880}, {0x3f800001, 0x3f490737}, {0xbf800000, 0xbf491881},
    {0xbf800001, 0xbf490737}, {0x40fc0000, 0x3fb8e492}, {0x40fbffff, 0x3fb8e492},
    {0x40fc0001, 0x3fb8e492}, {0x40f80000, 0x3fb8a28c}, {0xc0fc0000, 0xbfb8e492},
    {0x3e000000, 0x3dfeb49c}, {0x3e000001, 0x3dfeb49e}, {0x3ec00000, 0x3eb7abab},
    {0x71800000, 0x3fc90fdb}, {0xff000000, 0xbfc90fdb}, {0x7ed55555, 0x3fc90fdb},
    {0x7f7fffff, 0x3fc90fdb}, {0x3a83126f, 0x3a830e3c}, {0x40e4fbd4, 0x3fb749af},
    {0x40c0a15c, 0x3fb3fd74}, {0xc0b17f85, 0xbfb23b0a}, {0xc069b4ed, 0xbfa6da35},
    {0x3fe0f28d, 0x3f86d5ce}, {0x3f6a31fe, 0x3f3da76d}, {0x3f17031d, 0x3f08748f},
    {0xbf300fd9, 0xbf1a3ea2}, {0x3eb0e605, 0x3eaa4d64}, {0x3eb27177, 0x3eabae5b},
    {0x3e857473, 0x3e82892c}, {0xbfeb5a93, 0xbf894bc2}, {0xbe628300, 0xbe5ee8af},
    {0xbeb1d791, 0xbeab2512}, {0x52ab5846, 0x3fc90fdb}, {0x412698e9, 0x3fbcce08},
    {0xb49b45a6, 0xb49b4067}, {0xac880d76, 0xac8808dd},
};

constexpr point_of<std::uint64_t> atan_d_ha_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x0010000000000000, 0x0010000000000000}, {0x3ff0000000000000, 0x3fe921fb54442d18},
    {0x3fefffffffffffff, 0x3fe921fb54442d18}, {0x3ff0000000000001, 0x3fe921fb54442d19},
    {0xbff0000000000000, 0xbfe921fb54442d18}, {0xbff0000000000001, 0xbfe921fb54442d19},
    {0x401f800000000000, 0x3ff71c9fab4414b2}, {0x401f7fffffffffff, 0x3ff71c9fab4414b2},
    {0x401f800000000001, 0x3ff71c9fab4414b2}, {0x401f000000000000, 0x3ff7145eac2088a4},
    {0xc01f800000000000, 0xbff71c9fab4414b2}, {0x3fc0000000000000, 0x3fbfd5ba9aac2f6e},
    {0x3fc0000000000001, 0x3fbfd5ba9aac2f70}, {0x3fd8000000000000, 0x3fd6f61941e4def1},
    {0x4630000000000000, 0x3ff921fb54442d18}, {0xc7e0000000000000, 0xbff921fb54442d18},
    {0x47daaaaaaaaaaaab, 0x3ff921fb54442d18}, {0x7fefffffffffffff, 0x3ff921fb54442d18},
    {0x3f50624dd2f1a9fc, 0x3f50624d77516e16}, {0x3fdc0000ffffffff, 0x3fda64ef9aab66bd},
    {0x3fdc000100000000, 0x3fda64ef9aab66be}, {0x3fe60000ffffffff, 0x3fe345f0caa41b64},
    {0x3fe6000100000000, 0x3fe345f0caa41b64}, {0x3ff30000ffffffff, 0x3febde71c1b2cb90},
    {0x3ff3000100000000, 0x3febde71c1b2cb90}, {0x40038000ffffffff, 0x3ff2e7577245d827},
    {0x4003800100000000, 0x3ff2e7577245d827}, {0x002fffffffffffff, 0x002fffffffffffff},
    {0x0030000000000000, 0x0030000000000000}, {0x7dffffffffffffff, 0x3ff921fb54442d18},
    {0x7e00000000000000, 0x3ff921fb54442d18}, {0x47f0000000000000, 0x3ff921fb54442d18},
    {0xc7f8000000000000, 0xbff921fb54442d18}, {0x4800000000000000, 0x3ff921fb54442d18},
    {0xbff13e6048a32eb9, 0xbfea544df0a2ed17}, {0x3fc1e44c3be18663, 0x3fc1c6cfed97aa30},
    {0xbfdbb0b36e34a110, 0xbfda22415ac06020}, {0x3fd5a871566e5e8b, 0x3fd4e23ed03a6cf0},
    {0x3fdaaa1a1ee8d06c, 0x3fd943c6cec041d0}, {0xc01316c3ba323c44, 0xbff5d3ecac98ca2e},
    {0xc037b6d73b35b5fb, 0xbff8755c54a71223}, {0x3ffc870f32cca4e8, 0x3ff0f4569e2fd0c1},
    {0xbfee263770fb4ec9, 0xbfe82e1b998fe8bd}, {0xbff1a4a7721af3d4, 0xbfeab1c5d6caac7a},
    {0x40514629e2a460ed, 0x3ff8e6b4d0f195a5}, {0xbfb7f91c8e04b6e3, 0xbfb7e7440cd7cb40},
    {0x3ffc513478db5c0b, 0x3ff0e760f6ee82d3}, {0xbfb30b122b683c2d, 0xbfb3021bcd374670},
    {0x3e126b718e240e26, 0x3e126b718e240e26}, {0x41a77a11dbd61ecc, 0x3ff921fb52e73c87},
    {0x40dd3a350b521635, 0x3ff921d84b23c17a}, {0x3da7e2a28d0d83de, 0x3da7e2a28d0d83de},
};

constexpr point_of<std::uint64_t> atan_d_la_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x0010000000000000, 0x0010000000000000}, {0x3ff0000000000000, 0x3fe921fb54442d18},
    {0x3fefffffffffffff, 0x3fe921fb54442d18}, {0x3ff0000000000001, 0x3fe921fb54442d19},
    {0xbff0000000000000, 0xbfe921fb54442d18}, {0xbff0000000000001, 0xbfe921fb54442d19},
    {0x401f800000000000, 0x3ff71c9fab4414b2}, {0x401f7fffffffffff, 0x3ff71c9fab4414b3},
    {0x401f800000000001, 0x3ff71c9fab4414b2}, {0x401f000000000000, 0x3ff7145eac2088a4},
    {0xc01f800000000000, 0xbff71c9fab4414b2}, {0x3fc0000000000000, 0x3fbfd5ba9aac2f6e},
    {0x3fc0000000000001, 0x3fbfd5ba9aac2f6f}, {0x3fd8000000000000, 0x3fd6f61941e4def0},
    {0x4630000000000000, 0x3ff921fb54442d18}, {0xc7e0000000000000, 0xbff921fb54442d18},
    {0x47daaaaaaaaaaaab, 0x3ff921fb54442d18}, {0x7fefffffffffffff, 0x3ff921fb54442d18},
    {0x3f50624dd2f1a9fc, 0x3f50624d77516e16}, {0x3fdc0000ffffffff, 0x3fda64ef9aab66bd},
    {0x3fdc000100000000, 0x3fda64ef9aab66bd}, {0x3fe60000ffffffff, 0x3fe345f0caa41b64},
    {0x3fe6000100000000, 0x3fe345f0caa41b64}, {0x3ff30000ffffffff, 0x3febde71c1b2cb8f},
    {0x3ff3000100000000, 0x3febde71c1b2cb90}, {0x40038000ffffffff, 0x3ff2e7577245d827},
    {0x4003800100000000, 0x3ff2e7577245d827}, {0x002fffffffffffff, 0x002fffffffffffff},
    {0x0030000000000000, 0x0030000000000000}, {0x7dffffffffffffff, 0x3ff921fb54442d18},
    {0x7e00000000000000, 0x3ff921fb54442d18}, {0x47f0000000000000, 0x3ff921fb54442d18},
    {0xc7f8000000000000, 0xbff921fb54442d18}, {0x4800000000000000, 0x3ff921fb54442d18},
    {0xbff1740118dcead7, 0xbfea859a72c02559}, {0xc007c35df1058d00, 0xbff3efdb32973be8},
    {0xbfd5a9b024083468, 0xbfd4e35cda35e83c}, {0xbffe2f5afddaea1e, 0xbff1558dae12fcd6},
    {0xc012cc78c8702825, 0xbff5c73d766542a4}, {0xbfd46e43369a779a, 0xbfd3c6b99ceb4548},
    {0x400e43f4eaac36da, 0x3ff4ff80f318e751}, {0x3ff610d98b670fdd, 0x3fee307ff1cb723a},
    {0x3ff1963eeb5d334d, 0x3feaa4beed0f226e}, {0xbff316315ec31f74, 0xbfebf0cee41ac30f},
    {0x3fbd9dad82227ad5, 0x3fbd7c1fa38eb240}, {0xbfeb05145bd4a94f, 0xbfe6705d95a57a34},
    {0xbffa8379d864e4e8, 0xbff072016986f996}, {0xc00709fa184ad664, 0xbff3c90cc9e05bd3},
    {0xc204f7cdc316be2f, 0xbff921fb543e1255}, {0x416e712e4f294242, 0x3ff921fb43728fce},
    {0x3e5ab935de2b9528, 0x3e5ab935de2b9526}, {0xc07b2838bd548454, 0xbff9188e1dee9393},
};

constexpr point_of<std::uint64_t> atan_d_ep_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x0010000000000000, 0x000fffffff5ad422}, {0x3ff0000000000000, 0x3fe921fb539eb360},
    {0x3fefffffffffffff, 0x3fe921fb539eb360}, {0x3ff0000000000001, 0x3fe921fb54e9a6d0},
    {0xbff0000000000000, 0xbfe921fb539eb360}, {0xbff0000000000001, 0xbfe921fb54e9a6d0},
    {0x401f800000000000, 0x3ff71c9fab322e77}, {0x401f7fffffffffff, 0x3ff71c9fab322e77},
    {0x401f800000000001, 0x3ff71c9fab322e77}, {0x401f000000000000, 0x3ff7145eac0de7f0},
    {0xc01f800000000000, 0xbff71c9fab322e77}, {0x3fc0000000000000, 0x3fbfd5ba9bbf049d},
    {0x3fc0000000000001, 0x3fbfd5ba9bbf049f}, {0x3fd8000000000000, 0x3fd6f61941dfaced},
    {0x4630000000000000, 0x3ff921fb54442d18}, {0xc7e0000000000000, 0xbff921fb54442d18},
    {0x47daaaaaaaaaaaab, 0x3ff921fb54442d18}, {0x7fefffffffffffff, 0x3ff921fb54442d18},
    {0x3f50624dd2f1a9fc, 0x3f50624d76a85478}, {0x3fdc0000ffffffff, 0x3fda64ef9bb5ed91},
    {0x3fdc000100000000, 0x3fda64ef9bb5ed92}, {0x3fe60000ffffffff, 0x3fe345f0cb5d7459},
    {0x3fe6000100000000, 0x3fe345f0cb5d745a}, {0x3ff30000ffffffff, 0x3febde71c1ef1486},
    {0x3ff3000100000000, 0x3febde71c1ef1487}, {0x40038000ffffffff, 0x3ff2e7577219d5fa},
    {0x4003800100000000, 0x3ff2e7577219d5fa}, {0x002fffffffffffff, 0x002ffffffeb5a844},
    {0x0030000000000000, 0x002ffffffeb5a845}, {0x7dffffffffffffff, 0x3ff921fb54442d18},
    {0x7e00000000000000, 0x3ff921fb54442d18}, {0x47f0000000000000, 0x3ff921fb54442d18},
    {0xc7f8000000000000, 0xbff921fb54442d18}, {0x4800000000000000, 0x3ff921fb54442d18},
    {0x3fda008c035d77fc, 0x3fd8b2c5675a1957}, {0x3fee5dceba1d73e5, 0x3fe84b752b871184},
    {0x3ff550ed7797e5d7, 0x3feda93a8999b8ad}, {0x4015cbb54f7c4fd0, 0x3ff63a8c3b11e977},
    {0x3fee020144cee70e, 0x3fe81ae1da708e67}, {0x401004edd387809b, 0x3ff537b525acffe4},
    {0xc025b53ccf4f960e, 0xbff7a9abc66c9b55}, {0xbfbbbde14bef39f9, 0xbfbba24652b46371},
    {0x4016269101fc6767, 0x3ff64634b0259878}, {0x3fe02a678f9c57c0, 0x3fddf01beeb37fd3},
    {0x4008ce64dac445a4, 0x3ff424285a0266d6}, {0xc0057f44ebc152e9, 0xbff36eba7071ca4a},
    {0xbfb8f127a6a8b268, 0xbfb8dd10bcfdab9f}, {0xbff055c975d3d60e, 0xbfe976e069457dd5},
    {0x401520c064a3dcfd, 0x3ff62396183972ba}, {0xbe83b2e7bd2f78bd, 0xbe83b2e7bc641d9e},
    {0xc1f177a9ab7f42d9, 0xbff921fb54358532}, {0x3e2cf796715d82b6, 0x3e2cf79670327a0c},
};

constexpr point_of<std::uint64_t> atan_d_nolut_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000003, 0x8000000000000003},
    {0x0010000000000000, 0x0010000000000000}, {0x3ff0000000000000, 0x3fe921fb54442d18},
    {0x3fefffffffffffff, 0x3fe921fb54442d18}, {0x3ff0000000000001, 0x3fe921fb54442d19},
    {0xbff0000000000000, 0xbfe921fb54442d18}, {0xbff0000000000001, 0xbfe921fb54442d19},
    {0x401f800000000000, 0x3ff71c9fab4414b2}, {0x401f7fffffffffff, 0x3ff71c9fab4414b2},
    {0x401f800000000001, 0x3ff71c9fab4414b2}, {0x401f000000000000, 0x3ff7145eac2088a3},
    {0xc01f800000000000, 0xbff71c9fab4414b2}, {0x3fc0000000000000, 0x3fbfd5ba9aac2f6e},
    {0x3fc0000000000001, 0x3fbfd5ba9aac2f70}, {0x3fd8000000000000, 0x3fd6f61941e4def1},
    {0x4630000000000000, 0x3ff921fb54442d18}, {0xc7e0000000000000, 0xbff921fb54442d18},
    {0x47daaaaaaaaaaaab, 0x3ff921fb54442d18}, {0x7fefffffffffffff, 0x3ff921fb54442d18},
    {0x3f50624dd2f1a9fc, 0x3f50624d77516e16}, {0x3fdc0000ffffffff, 0x3fda64ef9aab66bd},
    {0x3fdc000100000000, 0x3fda64ef9aab66be}, {0x3fe60000ffffffff, 0x3fe345f0caa41b64},
    {0x3fe6000100000000, 0x3fe345f0caa41b64}, {0x3ff30000ffffffff, 0x3febde71c1b2cb8e},
    {0x3ff3000100000000, 0x3febde71c1b2cb90}, {0x40038000ffffffff, 0x3ff2e7577245d827},
    {0x4003800100000000, 0x3ff2e7577245d827}, {0x002fffffffffffff, 0x002fffffffffffff},
    {0x0030000000000000, 0x0030000000000000}, {0x7dffffffffffffff, 0x3ff921fb54442d18},
    {0x7e00000000000000, 0x3ff921fb54442d18}, {0x47f0000000000000, 0x3ff921fb54442d18},
    {0xc7f8000000000000, 0xbff921fb54442d18}, {0x4800000000000000, 0x3ff921fb54442d18},
    {0x3ff50f4949087446, 0x3fed798d410c1404}, {0x3ff9873eaa74ecd4, 0x3ff02ccae7b4bae9},
    {0xbfa813c6efab26d6, 0xbfa80f3d51109dc0}, {0xbfedb8d92183e609, 0xbfe7f3c8306ae1b5},
    {0xc07c3867c4945c67, 0xbff918e9092a6fe9}, {0x3fe1f3b917f01bd0, 0x3fe05c299016141b},
    {0xbfb7fb0825df2475, 0xbfb7e92b5e584330}, {0x3ff0fecc96ec0db7, 0x3fea19051c079028},
    {0xbfdaedc8127233a8, 0xbfd97d5c6e378f6c}, {0x3ff22615bfb58068, 0x3feb24c64b132efe},
    {0xbfebb6883cbfeb08, 0xbfe6d6dc202e1e8f}, {0x3ff647ceab7b6e00, 0x3fee5622c01695c5},
    {0x3fec28e39d2ce4c6, 0x3fe717c1afeb2f5a}, {0xbfd1b6c10d0da38b, 0xbfd1480105724830},
    {0x409cff31544d4bef, 0x3ff91fc64d60ea30}, {0xc02802b1945efc05, 0xbff7cd95754008e4},
    {0x3eb716dbf95174d0, 0x3eb716dbf95164c9}, {0x40d18faa0f22cd52, 0x3ff921c104cd8fa0},
};

TEST(AtanFloat, Points) {
  expect_points<atan_s<tier::ha>>(atan_s_ha_points);
  expect_points<atan_s<tier::la>>(atan_s_la_points);
  expect_points<atan_s<tier::ep>>(atan_s_ep_points);
}

TEST(AtanDouble, Points) {
  expect_points<atan_d<tier::ha>>(atan_d_ha_points);
  expect_points<atan_d<tier::la>>(atan_d_la_points);
  expect_points<atan_d<tier::ep>>(atan_d_ep_points);
  expect_points<atan_d_nolut>(atan_d_nolut_points);
}

TEST(AtanFloat, Digest) {
  EXPECT_EQ(digest<atan_s<tier::ha>>(1e-3), 0xeb6c35db41ea0c4du);
  EXPECT_EQ(digest<atan_s<tier::la>>(1e-3), 0x9124a5db23ee7a11u);
  EXPECT_EQ(digest<atan_s<tier::ep>>(1e-3), 0x8959a034bb3f7d1bu);
}

TEST(AtanDouble, Digest) {
  EXPECT_EQ(digest<atan_d<tier::ha>>(1e-3), 0xef640eab3e2e03c3u);
  EXPECT_EQ(digest<atan_d<tier::la>>(1e-3), 0xd0baede7438e1041u);
  EXPECT_EQ(digest<atan_d<tier::ep>>(1e-3), 0x1e9e4837fa3ff4b7u);
  EXPECT_EQ(digest<atan_d_nolut>(1e-3), 0xe0f40238c8c0debdu);
}

template <typename Body>
class Atan : public ::testing::Test {};
using all_bodies =
    ::testing::Types<atan_s<tier::ha>, atan_s<tier::la>, atan_s<tier::ep>, atan_d<tier::ha>,
                     atan_d<tier::la>, atan_d<tier::ep>, atan_d_nolut>;
TYPED_TEST_SUITE(Atan, all_bodies);

TYPED_TEST(Atan, Specials) {
  using T = typename TypeParam::input_type;
  using n = named<part_of<T>>;
  expect_v11<TypeParam>(0, 0);
  expect_v11<TypeParam>(n::sign, n::sign);
  const T infinity = std::numeric_limits<T>::infinity();
  expect_number<TypeParam>(infinity, T(1.57079632679489661923));
  expect_number<TypeParam>(-infinity, -T(1.57079632679489661923));
  expect_quiet_nans<TypeParam>();
}

/// At 1 the selection of la takes -1/a: pi/2 - arctan 1 by the polynomial, not arctan 1.
TEST(AtanFloat, OneIsInverted) {
  const float one = 1.0f;
  float y = 0;
  EXPECT_EQ(atan_s<tier::la>::call(&one, &y), 0u);
  const float p = scalar::arctangent_factor(1.0f);
  EXPECT_EQ(y, std::fma(p, -1.0f, std::bit_cast<float>(0x3fc90fdbu)));
}

/// From 7.875 the argument is inverted; below it is next to a row of the table. 7.875 itself is
/// halfway between the last row and one that the table does not have.
TEST(AtanDouble, LastRowOfLa) {
  const double p = std::nextafter(7.875, 0.0);
  for (const double x : {7.75, p, 7.875, std::nextafter(7.875, 8.0), 8.0, 1e9}) {
    double y = 0;
    EXPECT_EQ(atan_d<tier::la>::call(&x, &y), 0u);
    EXPECT_LE(distance(std::bit_cast<std::uint64_t>(y), std::bit_cast<std::uint64_t>(std::atan(x))),
              2u)
        << x;
  }
}

TEST(AtanDouble, RangeOfTheMainPathOfHa) {
  const auto stands = [](std::uint64_t x) {
    return atan_d<tier::ha>::main(element<double>::value(x)).rare == 0;
  };
  for (const std::uint64_t sign : {std::uint64_t{0}, named<std::uint64_t>::sign}) {
    EXPECT_FALSE(stands(sign));
    EXPECT_FALSE(stands(sign | 0x002fffffffffffff));
    EXPECT_TRUE(stands(sign | 0x0030000000000000));
    EXPECT_TRUE(stands(sign | 0x7dffffffffffffff));
    EXPECT_FALSE(stands(sign | 0x7e00000000000000));
    EXPECT_FALSE(stands(sign | 0x7ff0000000000000));
    EXPECT_FALSE(stands(sign | 0x7ff8000000000000));
  }
}

/// The words of the segments as they are known.
TEST(AtanTables, Words) {
  constexpr std::uint64_t all = ~std::uint64_t{0};
  constexpr std::uint64_t rows[] = {0x3ff0000000000000,
                                    0,
                                    0x3ff921fb54442d18,
                                    0x3c91a62633145c07,
                                    0x3ff8000000000000,
                                    all,
                                    0x3fef730bd281f69b,
                                    0x3c7007887af0cbbd,
                                    0x3ff0000000000000,
                                    all,
                                    0x3fe921fb54442d18,
                                    0x3c81a62633145c07,
                                    0x3fe0000000000000,
                                    all,
                                    0x3fddac670561bb4f,
                                    0x3c7a2b7f222f65e2,
                                    0,
                                    all,
                                    0,
                                    0};
  ASSERT_EQ(std::size(scalar::internal_datan_ha_data), std::size(rows));
  for (std::size_t i = 0; i < std::size(rows); ++i)
    EXPECT_EQ(scalar::internal_datan_ha_data[i], rows[i]) << i;
}

}  // namespace
