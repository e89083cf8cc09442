// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/atrig/atan2pi.hpp"

#include "atrig_cases.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::atan2pi_d;
using scalar::atan2pi_s;
using scalar::atan2pi_s_ep;
using scalar::atan2pi_s_nofp64;
using scalar::tier;

constexpr pair_of<std::uint32_t> atan2pi_s_nofp64_pairs[] = {
    {0x3f800000, 0x3f800000, 0x3e7fffff}, {0xbf800000, 0x3f800000, 0xbe7fffff},
    {0x3f800000, 0xbf800000, 0x3f400000}, {0xbf800000, 0xbf800000, 0xbf400000},
    {0x3f800000, 0x3f800001, 0x3e7ffffe}, {0x3f800001, 0x3f800000, 0x3e800001},
    {0x3f800000, 0xbf800001, 0x3f400000}, {0x00000000, 0x3f800000, 0x00000000},
    {0x80000000, 0xbf800000, 0xbf800000}, {0x3f800000, 0x00000000, 0x3f000000},
    {0xbf800000, 0x80000000, 0xbf000000}, {0x00000001, 0x00000001, 0x3e7fffff},
    {0x00000001, 0x00000003, 0x3dd1bfae}, {0x007fffff, 0x00800000, 0x3e7ffffe},
    {0x00800000, 0x007fffff, 0x3e800001}, {0x807fffff, 0x007ffffe, 0xbe800001},
    {0x7e800000, 0x3f800000, 0x3f000000}, {0x7e800001, 0x7e000000, 0x3eb46fec},
    {0x7f7fffff, 0xff7fffff, 0x3f400000}, {0x7f7fffff, 0x7f7ffffe, 0x3e800000},
    {0x3f800000, 0x7f7fffff, 0x000a2f98}, {0x00400000, 0x7f000000, 0x00000000},
    {0x00000001, 0x3f000000, 0x00000001}, {0x00000001, 0xbf000000, 0x3f800000},
    {0x00ffffff, 0x80400000, 0x3f13f671}, {0xbf062980, 0x3db529b4, 0xbee4bf8a},
    {0xbe852a79, 0x3e54d407, 0xbe921f75}, {0x3e80bcd3, 0xbf5e7300, 0x3f690c23},
    {0xbf79420c, 0x3f2cc8bf, 0xbe9d36c5}, {0xbef66be7, 0xbf0805c6, 0xbf440624},
    {0x3f7dc529, 0xbd7399f2, 0x3f04e20e}, {0x3f2c44ad, 0xbd41b6ea, 0x3f05b7b4},
    {0x3e8e67e1, 0xbf32e267, 0x3f6121a5}, {0x3e8a18ea, 0x3f3c706f, 0x3de4f78b},
    {0x3d3de686, 0x3ef70aba, 0x3cf9ca1f}, {0x3eaf867d, 0xbf5f3745, 0x3f617965},
    {0x3f0436c1, 0x3e3a926b, 0x3ec8ba05}, {0xbecb807e, 0xbf701f3a, 0xbf5f56d3},
    {0x3f3b2663, 0xbd5f3d4e, 0x3f061058}, {0x3ee01361, 0x3f41f3c0, 0x3e2abdde},
    {0x3edb44c2, 0x3f579a3f, 0x3e1955c4}, {0xc45c9a9c, 0xc6981b98, 0xbf7c4f30},
    {0x3734c2a7, 0xb99540a5, 0x3f7ceadc}, {0x3e226252, 0x3a856e46, 0x3efef42c},
    {0x3a20641f, 0xc049dc4b, 0x3f7ffbf4}, {0x4641dde7, 0x474fe470, 0x3d955002},
    {0x490e238d, 0x37fc3046, 0x3f000000}, {0x488a84d9, 0x40aff919, 0x3effff31},
    {0x39150764, 0x40a3035e, 0x3714fe61},
};

constexpr pair_of<std::uint64_t> atan2pi_d_la_pairs[] = {
    {0x3ff0000000000000, 0x3ff0000000000000, 0x3fd0000000000000},
    {0xbff0000000000000, 0x3ff0000000000000, 0xbfd0000000000000},
    {0x3ff0000000000000, 0xbff0000000000000, 0x3fe8000000000000},
    {0xbff0000000000000, 0xbff0000000000000, 0xbfe8000000000000},
    {0x3ff0000000000000, 0x3ff0000000000001, 0x3fd0000000000000},
    {0x3ff0000000000001, 0x3ff0000000000000, 0x3fd0000000000000},
    {0x3ff0000000000000, 0xbff0000000000001, 0x3fe8000000000000},
    {0x0000000000000000, 0x3ff0000000000000, 0x0000000000000000},
    {0x8000000000000000, 0xbff0000000000000, 0xbff0000000000000},
    {0x3ff0000000000000, 0x0000000000000000, 0x3fe0000000000000},
    {0xbff0000000000000, 0x8000000000000000, 0xbfe0000000000000},
    {0xbfe0e4968d92d832, 0xbfe965ba4a3af2a2, 0xbfea057a3e826125},
    {0xbfca9bed50ad0738, 0xbfe614ef2f477986, 0xbfed04fe9d1a8ab8},
    {0xbfebbe3777d76a18, 0xbfc93154ce6b4cd8, 0xbfe2461af941bc64},
    {0x3feabfc68250a43a, 0x3fe33a9c7feb9222, 0x3fd34d827395d904},
    {0x3fe0f86c907884ce, 0xbfe1cbedc3d6585e, 0x3fe83df449dd8902},
    {0x3fb2c7b8d70e40a0, 0xbfdc95a9c3862988, 0x3fee577dd06715b2},
    {0xbfe4f3107962911a, 0xbfe9344afde7ff92, 0xbfe8efb5cdb07a35},
    {0xbfe247436874d1ba, 0x3feb5bc2c0348292, 0xbfc7ff7c3554bde5},
    {0x3fe50d06ad20215c, 0x3fe3a0312a150020, 0x3fd0b6a4964ea743},
    {0x3fe33a89922c8a16, 0xbfe39ec036ae73c4, 0x3fe81a4643d15c70},
    {0xbfd856d62b5da1bc, 0x3fd040bc8de08ca8, 0xbfd4017d9311d916},
    {0x3fddaeb9cf5ff0c0, 0x3fe6b28f06c9c9b6, 0x3fc7982777c42eb9},
    {0x3fe852c062faa93a, 0xbfea7335493ddf26, 0x3fe86d29a86dc2d5},
    {0x3fcb191beacc0040, 0x3fd5fa503634f804, 0x3fc682503d37ccd0},
    {0x3f8862fc7f6c5a00, 0xbfe49f15f6057bee, 0x3fefcfd28ec69756},
    {0xbfab0bc6dc290a00, 0xbfea4826d8718134, 0xbfef588476ef62c2},
    {0x447dbe9d967d08fa, 0x3d393c80e9a457eb, 0x3fe0000000000000},
    {0x40d22a31e6638745, 0x4442a83d99f49e70, 0x3c63d58f3e9021c5},
    {0x3e7da1ac1ae26398, 0x3eed42c6fce1046c, 0x3f64a1257271e566},
    {0xbd76036f80b1db78, 0x3a2f57ada46c8a7e, 0xbfdfffffffffffff},
    {0xc18181e266f790df, 0xc04aab42421f56e4, 0xbfe00000f8426bf8},
    {0xbdb5d6dde49dc544, 0x3c213acdce21d5b9, 0xbfdffffff7f6ca2d},
    {0xbc1029e6c82860e5, 0x3d0459211337c585, 0xbee02eb71bbf7b00},
    {0xc2e828338171e2eb, 0xc092b845d1f6bde6, 0xbfe0000000003f26},
};

TEST(Atan2piFloat, Points) { expect_pairs<atan2pi_s_nofp64>(atan2pi_s_nofp64_pairs); }
TEST(Atan2piDouble, Points) {
  expect_pairs<atan2pi_d<tier::la>>(atan2pi_d_la_pairs);
  expect_pairs<atan2pi_d<tier::ep>>(atan2pi_d_la_pairs);
}

TEST(Atan2piFloat, Digest) { EXPECT_EQ(pair_digest<atan2pi_s_nofp64>(), 0xad22f17a87bf5c3du); }
TEST(Atan2piDouble, Digest) { EXPECT_EQ(pair_digest<atan2pi_d<tier::la>>(), 0x00993b1fa468d62au); }

TEST(Atan2piFloat, Angles) {
  expect_angles<atan2pi_s>(1, 1);
  expect_angles<atan2pi_s_nofp64>(1, 3);
  expect_angles<atan2pi_s_ep>(1, 2900);
}

TEST(Atan2piDouble, Angles) {
  expect_angles<atan2pi_d<tier::ha>>(1, 1);
  expect_angles<atan2pi_d<tier::la>>(1, 3);
  expect_angles<atan2pi_d<tier::ep>>(1, 3);
}

/// The diagonals are multiples of a quarter where the polynomial is not seen.
TEST(Atan2piDouble, Diagonals) {
  for (const double m : {0x1p-1074, 0x1p-1021, 1.0, 3.7, 0x1.fp1023}) {
    expect_number<atan2pi_d<tier::ha>>(m, m, 0.25, none);
    expect_number<atan2pi_d<tier::ha>>(-m, m, -0.25, none);
    expect_number<atan2pi_d<tier::ha>>(m, -m, 0.75, none);
    expect_number<atan2pi_d<tier::ha>>(-m, -m, -0.75, none);
  }
}

}  // namespace
