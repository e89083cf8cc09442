// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0

#include "scalar/log/log1p.hpp"

#include "log_cases.hpp"
#include "quad.hpp"

namespace {

using namespace arbor::lumen::tests;
using namespace arbor::lumen::vm::detail::gpu::norvane;
using scalar::log1p_d;
using scalar::log1p_d_nolut;
using scalar::log1p_s;
using scalar::tier;

constexpr point_of<std::uint32_t> log1p_s_ha_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000001, 0x80000001}, {0x00800000, 0x00800000}, {0x80800000, 0x80800000},
    {0x33800000, 0x337fffff}, {0x33000000, 0x33000000}, {0xb3800000, 0xb3800000},
    {0x3f800000, 0x3f317218}, {0x3f7fffff, 0x3f317217}, {0x3f800001, 0x3f317219},
    {0xbf000000, 0xbf317218}, {0xbf000001, 0xbf31721a}, {0xbeffffff, 0xbf317217},
    {0xbf7fffff, 0xc1851592}, {0xbf7ffffe, 0xc17f1402}, {0xbeaaaaab, 0xbecf9920},
    {0xbeaaaaac, 0xbecf9921}, {0x3eaaaaab, 0x3e934b11}, {0x3eaaaaac, 0x3e934b12},
    {0x3e800000, 0x3e647fbe}, {0x3e400000, 0x3e2ff984}, {0x41200000, 0x4019771e},
    {0x4b000000, 0x417f1403}, {0x4b800001, 0x41851592}, {0x51326c1c, 0x41c4bcfa},
    {0x5e647dde, 0x422b721f}, {0x34367177, 0x34367176}, {0x6c1985ed, 0x42777cd9},
    {0x5060f51b, 0x41bb807d}, {0x3723209c, 0x37232068}, {0x4493b446, 0x40e26a7d},
    {0x3efd887b, 0x3ecdf36f}, {0x6016ecbf, 0x4234e095}, {0x6c8a7451, 0x4279d8d7},
    {0xb971f65a, 0xb971fd80}, {0xbb97959c, 0xbb97efa5}, {0xbe333e96, 0xbe450af0},
    {0xb721afe8, 0xb721b01b}, {0xbeaedcf4, 0xbed5ee8a}, {0xb97d4235, 0xb97d4a0a},
    {0xb5b5b739, 0xb5b5b741}, {0xb8f7b9aa, 0xb8f7bd69}, {0xbc07c966, 0xbc085a3f},
    {0xb9f8c281, 0xb9f8d19e}, {0x7a7fffff, 0x42a3952e}, {0x7a800000, 0x42a3952e},
};

constexpr point_of<std::uint32_t> log1p_s_la_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000001, 0x80000001}, {0x00800000, 0x00800000}, {0x80800000, 0x80800000},
    {0x33800000, 0x33800000}, {0x33000000, 0x33000000}, {0xb3800000, 0xb3800000},
    {0x3f800000, 0x3f317218}, {0x3f7fffff, 0x3f317218}, {0x3f800001, 0x3f317219},
    {0xbf000000, 0xbf317218}, {0xbf000001, 0xbf31721a}, {0xbeffffff, 0xbf317217},
    {0xbf7fffff, 0xc1851592}, {0xbf7ffffe, 0xc17f1402}, {0xbeaaaaab, 0xbecf9920},
    {0xbeaaaaac, 0xbecf9921}, {0x3eaaaaab, 0x3e934b12}, {0x3eaaaaac, 0x3e934b12},
    {0x3e800000, 0x3e647fbf}, {0x3e400000, 0x3e2ff983}, {0x41200000, 0x4019771e},
    {0x4b000000, 0x417f1403}, {0x4b800001, 0x41851592}, {0x47ce4158, 0x41391445},
    {0x625914f8, 0x42416bee}, {0x44ede92f, 0x40f1a8dc}, {0x39b50f24, 0x39b50724},
    {0x42432175, 0x407a1737}, {0x6970603f, 0x4268a543}, {0x40b7ae33, 0x3ff43b61},
    {0x416d44bc, 0x4030c257}, {0x30ba2898, 0x30ba2898}, {0x312e19d9, 0x312e19d9},
    {0xb8d9eeef, 0xb8d9f1d5}, {0xb8f29c61, 0xb8f29ff9}, {0xb8275915, 0xb82759f0},
    {0xb829eba0, 0xb829ec82}, {0xba20fe75, 0xba210b1e}, {0xba84b74b, 0xba84c881},
    {0xb8aea692, 0xb8aea86f}, {0xbe20a8c9, 0xbe2ec222}, {0xb8c6c6e2, 0xb8c6c94b},
    {0xb8681d66, 0xb8681f0b}, {0x7efffffe, 0x42b00f34}, {0x7effffff, 0x42b00f34},
};

constexpr point_of<std::uint32_t> log1p_s_ep_points[] = {
    {0x00000000, 0x00000000}, {0x80000000, 0x80000000}, {0x00000001, 0x00000001},
    {0x80000001, 0x80000001}, {0x00800000, 0x00800000}, {0x80800000, 0x80800000},
    {0x33800000, 0x33800000}, {0x33000000, 0x33000000}, {0xb3800000, 0xb3800000},
    {0x3f800000, 0x3f317218}, {0x3f7fffff, 0x3f317218}, {0x3f800001, 0x3f317219},
    {0xbf000000, 0xbf317218}, {0xbf000001, 0xbf31721a}, {0xbeffffff, 0xbf317217},
    {0xbf7fffff, 0xc1851592}, {0xbf7ffffe, 0xc17f1402}, {0xbeaaaaab, 0xbecf955a},
    {0xbeaaaaac, 0xbecf955b}, {0x3eaaaaab, 0x3e935064}, {0x3eaaaaac, 0x3e935064},
    {0x3e800000, 0x3e647a03}, {0x3e400000, 0x3e2ff5f7}, {0x41200000, 0x40197721},
    {0x4b000000, 0x417f1403}, {0x4b800001, 0x41851592}, {0x49b3551d, 0x416333c8},
    {0x618d77ab, 0x423cefaa}, {0x56beb6f8, 0x4201224b}, {0x3342d00e, 0x3342d00e},
    {0x5ebb78c5, 0x422d6d41}, {0x659ba9c8, 0x42537fd4}, {0x45be0c40, 0x410b690d},
    {0x43265c32, 0x40a3d83c}, {0x524496fe, 0x41d09aa4}, {0x38d67f80, 0x38d67cb1},
    {0xbacf46a6, 0xbacf70a6}, {0xba525deb, 0xba52738a}, {0xbf2656aa, 0xbf864a8e},
    {0xbee0d5a8, 0xbf14097e}, {0xb58ddb74, 0xb58ddb79}, {0xbf092139, 0xbf4463a4},
    {0xbae8068b, 0xbae83b2e}, {0xb68e6d8e, 0xb68e6da2}, {0xba759672, 0xba75b3ea},
    {0xbb2f84e6, 0xbb2fc12d}, {0x7efffffe, 0x42b00f34}, {0x7effffff, 0x42b00f34},
};

constexpr point_of<std::uint32_t> log1p_s_rare_points[] = {
    {0x7a800001, 0x42a3952e}, {0x7b123456, 0x42a53c28}, {0x7effffff, 0x42b00f34},
    {0x7f000000, 0x42b00f34}, {0x7f000001, 0x42b00f34}, {0x7f7fffff, 0x42b17218},
    {0x7f2aaaaa, 0x42b0a27f}, {0x3c1fffff, 0x3c1f394b}, {0x3c200000, 0x3c1f394b},
    {0x3c200001, 0x3c1f394b}, {0xbc200000, 0xbc20c950}, {0xbc200001, 0xbc20c950},
    {0x3f800000, 0x3f317218}, {0xbf000000, 0xbf317218}, {0xbf7fffff, 0xc1851592},
    {0x42280000, 0x4070b781}, {0x3dcccccd, 0x3dc331ff},
};

constexpr point_of<std::uint64_t> log1p_d_ha_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000001, 0x8000000000000001},
    {0x0010000000000000, 0x0010000000000000}, {0x8010000000000000, 0x8010000000000000},
    {0x3ca0000000000000, 0x3ca0000000000000}, {0x3c90000000000000, 0x3c90000000000000},
    {0xbca0000000000000, 0xbca0000000000000}, {0x3ff0000000000000, 0x3fe62e42fefa39ef},
    {0x3fefffffffffffff, 0x3fe62e42fefa39ef}, {0x3ff0000000000001, 0x3fe62e42fefa39f0},
    {0xbfe0000000000000, 0xbfe62e42fefa39ef}, {0xbfe0000000000001, 0xbfe62e42fefa39f1},
    {0xbfdfffffffffffff, 0xbfe62e42fefa39ee}, {0xbfefffffffffffff, 0xc0425e4f7b2737fa},
    {0xbfeffffffffffffe, 0xc04205966f2b4f12}, {0xbfd5555555555555, 0xbfd9f323ecbf984b},
    {0xbfd5555555555556, 0xbfd9f323ecbf984d}, {0x3fd5555555555555, 0x3fd269621134db92},
    {0x3fd5555555555556, 0x3fd269621134db93}, {0x3fd0000000000000, 0x3fcc8ff7c79a9a22},
    {0x3fc8000000000000, 0x3fc5ff3070a793d4}, {0x4024000000000000, 0x40032ee3b77f374c},
    {0x4330000000000000, 0x404205966f2b4f12}, {0x4340000000000001, 0x40425e4f7b2737fa},
    {0x3ea2d1d1d18a669a, 0x3ea2d1d178ff0a57}, {0x41c2448c7b121dc5, 0x40343bdb7ac35ad5},
    {0x3daa6a6450d7d13f, 0x3daa6a6450d722cd}, {0x3ff7c22f7b3120df, 0x3fed20a6f6091c3a},
    {0x3d98b1a5b4653252, 0x3d98b1a5b464e619}, {0x3e3ca90f0e979cf3, 0x3e3ca90f0cfce77b},
    {0x3f0c747dbff29101, 0x3f0c744b25624c5f}, {0x3f6bfe89d84a1d3a, 0x3f6bf2523f2efe92},
    {0x40947caf04a012e8, 0x401cb7bea7efa30c}, {0x3f89c218c9a937a6, 0x3f8998f937abaafc},
    {0xbf70b2f75dbe4409, 0xbf70bbb453021b6d}, {0xbf97d8510252f615, 0xbf98208328a834a5},
    {0xbfef57502e50bd4e, 0xc00f101df6020a91}, {0xbeecf043324f3e81, 0xbeecf0504817e650},
    {0xbf2dff16c177f113, 0xbf2dfff7bc97121a}, {0xbf9ca62ef129c8c6, 0xbf9d0ebc1c4406eb},
    {0xbfb665e058296818, 0xbfb7705facb7050e}, {0xbf30752c8652dbd0, 0xbf3075b3f9ba4a0f},
    {0xbf9cfaa4c68deb5d, 0xbf9d65a3f8d1bfd5}, {0xbfddf5761ba95a54, 0xbfe433b64aeb9016},
    {0x7f3ffffffffff000, 0x4085f143c6bd09cc}, {0x7f3fffffffffefff, 0x4085f143c6bd09cc},
    {0x3ff69d3d82a250b9, 0x3fec3169c28ac861}, {0x3ff69d3d19e61493, 0x3fec31696bbf34f3},
    {0x3ff6a209b0928c65, 0x3fec35635163da5b}, {0x3ff69a0b834443aa, 0x3fec2ec3c474b00c},
};

constexpr point_of<std::uint64_t> log1p_d_la_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000001, 0x8000000000000001},
    {0x0010000000000000, 0x0010000000000000}, {0x8010000000000000, 0x8010000000000000},
    {0x3ca0000000000000, 0x3ca0000000000000}, {0x3c90000000000000, 0x3c90000000000000},
    {0xbca0000000000000, 0xbca0000000000000}, {0x3ff0000000000000, 0x3fe62e42fefa39ef},
    {0x3fefffffffffffff, 0x3fe62e42fefa39ee}, {0x3ff0000000000001, 0x3fe62e42fefa39f0},
    {0xbfe0000000000000, 0xbfe62e42fefa39ef}, {0xbfe0000000000001, 0xbfe62e42fefa39f1},
    {0xbfdfffffffffffff, 0xbfe62e42fefa39ee}, {0xbfefffffffffffff, 0xc0425e4f7b2737fa},
    {0xbfeffffffffffffe, 0xc04205966f2b4f12}, {0xbfd5555555555555, 0xbfd9f323ecbf984c},
    {0xbfd5555555555556, 0xbfd9f323ecbf984d}, {0x3fd5555555555555, 0x3fd269621134db92},
    {0x3fd5555555555556, 0x3fd269621134db92}, {0x3fd0000000000000, 0x3fcc8ff7c79a9a21},
    {0x3fc8000000000000, 0x3fc5ff3070a793d4}, {0x4024000000000000, 0x40032ee3b77f374b},
    {0x4330000000000000, 0x404205966f2b4f12}, {0x4340000000000001, 0x40425e4f7b2737fa},
    {0x426f7630bf9703c0, 0x403bb57be3cf5ac9}, {0x3f203985cc170c31, 0x3f203943fe115709},
    {0x3e8dedd8dc14ed57, 0x3e8dedd8a418ec11}, {0x3fa6bc7a0960afe9, 0x3fa63ef208317f4b},
    {0x3ddaf9571757905e, 0x3ddaf9571751e12d}, {0x404a60db573ac59a, 0x400fe030dc4d0720},
    {0x3f16a8309c5f319e, 0x3f16a7f072762545}, {0x3d5f8131eb07c30d, 0x3d5f8131eb07bb4c},
    {0x3e6495d057079670, 0x3e6495d05068958c}, {0x41cef047ec983704, 0x4034c2bc30419789},
    {0xbedf243c8b8e8f4e, 0xbedf24441f289a43}, {0xbf4cc2745119cdcc, 0xbf4cc5afea398a69},
    {0xbf4e5d09b06dbee0, 0xbf4e60a432695a9f}, {0xbfa7b3d1ff297d0e, 0xbfa844c332c50f5a},
    {0xbed9735b0c6dea3d, 0xbed973601be6c865}, {0xbfe3884bfc985000, 0xbfee29ce91baa486},
    {0xbec04b8f67e84707, 0xbec04b90717097e4}, {0xbf600add980dc6ff, 0xbf600ee4614231b6},
    {0xbf301b60d3881a50, 0xbf301be2907d424b}, {0xbefa8fe36bf84914, 0xbefa8ff978693e70},
    {0x7f3ffffffffff000, 0x4085f143c6bd09cc}, {0x7f3fffffffffefff, 0x4085f143c6bd09cc},
    {0x3ff69d3d82a250b9, 0x3fec3169c28ac861}, {0x3ff69d3d19e61493, 0x3fec31696bbf34f3},
    {0x3ff6a209b0928c65, 0x3fec35635163da5b}, {0x3ff69a0b834443aa, 0x3fec2ec3c474b00c},
};

constexpr point_of<std::uint64_t> log1p_d_ep_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000001, 0x8000000000000001},
    {0x0010000000000000, 0x0010000000000000}, {0x8010000000000000, 0x8010000000000000},
    {0x3ca0000000000000, 0x3ca0000000000000}, {0x3c90000000000000, 0x3c90000000000000},
    {0xbca0000000000000, 0xbca0000000000000}, {0x3ff0000000000000, 0x3fe62e42fefa39ef},
    {0x3fefffffffffffff, 0x3fe62e42fefa39ee}, {0x3ff0000000000001, 0x3fe62e42fefa39f0},
    {0xbfe0000000000000, 0xbfe62e42fefa39ef}, {0xbfe0000000000001, 0xbfe62e42fefa39f1},
    {0xbfdfffffffffffff, 0xbfe62e42fefa39ee}, {0xbfefffffffffffff, 0xc0425e4f7b2737fa},
    {0xbfeffffffffffffe, 0xc04205966f2b4f12}, {0xbfd5555555555555, 0xbfd9f323ecbf984c},
    {0xbfd5555555555556, 0xbfd9f323ecbf984d}, {0x3fd5555555555555, 0x3fd269621134db92},
    {0x3fd5555555555556, 0x3fd269621134db92}, {0x3fd0000000000000, 0x3fcc8ff7c79a9a41},
    {0x3fc8000000000000, 0x3fc5ff3070a79476}, {0x4024000000000000, 0x40032ee3b77f3755},
    {0x4330000000000000, 0x404205966f2b4f12}, {0x4340000000000001, 0x40425e4f7b2737fa},
    {0x414b49cfea83854a, 0x402e2e0f6d21cd3d}, {0x4299cf0a08606af8, 0x403d971e50a4f09e},
    {0x3edc69567e5a3930, 0x3edc69502fef8f92}, {0x3dd80f04d6a34d3e, 0x3dd80f04d69ec79a},
    {0x40b32b64bb4e5c11, 0x4020ff55dd7ceadb}, {0x3d3fed61f325ffbe, 0x3d3fed61f325fdc0},
    {0x435c061aa161d909, 0x4042fec5e906b7b7}, {0x3f7f8220c9bafe62, 0x3f7f6343181fecfe},
    {0x3d89bec01b4c24c2, 0x3d89bec01b4bfb55}, {0x3f2be62e6f3f0240, 0x3f2be56bdf1fe970},
    {0xbece172e2634f16f, 0xbece1731afa6699e}, {0xbf875ee3d8407b1a, 0xbf878149e8c5175f},
    {0xbef84bae4b78dc3d, 0xbef84bc0bdc3f68d}, {0xbfeda554ffd21f09, 0xc004e05a240b319c},
    {0xbf06ad2ada2d3b3d, 0xbf06ad4afdf1fdf1}, {0xbfbb5d0ef9dba1db, 0xbfbcf074f70e0d1e},
    {0xbf52a9debac0d757, 0xbf52ac97ea5b461e}, {0xbf3c4e627aa286ac, 0xbf3c4ff336f00a25},
    {0xbfa0ae6f4a807546, 0xbfa0f58d03a9161f}, {0xbee9a182258170f9, 0xbee9a18c694c2d47},
    {0x7f3ffffffffff000, 0x4085f143c6bd09cc}, {0x7f3fffffffffefff, 0x4085f143c6bd09cc},
    {0x3ff69d3d82a250b9, 0x3fec3169c28ac8d1}, {0x3ff69d3d19e61493, 0x3fec31696bbf3563},
    {0x3ff6a209b0928c65, 0x3fec35635163da61}, {0x3ff69a0b834443aa, 0x3fec2ec3c474b00d},
};

constexpr point_of<std::uint64_t> log1p_d_rare_points[] = {
    {0x7f3ffffffffff001, 0x4085f143c6bd09cc}, {0x7f40000000000000, 0x4085f143c6bd09d0},
    {0x7f93456789abcdef, 0x40860e7a91b547e8}, {0x7fefffffffffffff, 0x40862e42fefa39ef},
    {0x3f84000000000000, 0x3f83e7295d25a7d9}, {0x3f84000000000001, 0x3f83e7295d25a7d9},
    {0x3f83ffffffffffff, 0x3f83e7295d25a7d9}, {0xbf84000000000000, 0xbf841929f96832f0},
    {0xbf84000000000001, 0xbf841929f96832f0}, {0x3ff0000000000000, 0x3fe62e42fefa39ef},
    {0xbfe0000000000000, 0xbfe62e42fefa39ef}, {0xbfefffffffffffff, 0xc0425e4f7b2737fa},
    {0x40591234567890ab, 0x401278c362eec164},
};

constexpr point_of<std::uint64_t> log1p_d_nolut_points[] = {
    {0x0000000000000000, 0x0000000000000000}, {0x8000000000000000, 0x8000000000000000},
    {0x0000000000000001, 0x0000000000000001}, {0x8000000000000001, 0x8000000000000001},
    {0x0010000000000000, 0x0010000000000000}, {0x8010000000000000, 0x8010000000000000},
    {0x3ca0000000000000, 0x3ca0000000000000}, {0x3c90000000000000, 0x3c90000000000000},
    {0xbca0000000000000, 0xbca0000000000000}, {0x3ff0000000000000, 0x3fe62e42fefa39ef},
    {0x3fefffffffffffff, 0x3fe62e42fefa39ee}, {0x3ff0000000000001, 0x3fe62e42fefa39f0},
    {0xbfe0000000000000, 0xbfe62e42fefa39ef}, {0xbfe0000000000001, 0xbfe62e42fefa39f1},
    {0xbfdfffffffffffff, 0xbfe62e42fefa39ee}, {0xbfefffffffffffff, 0xc0425e4f7b2737fa},
    {0xbfeffffffffffffe, 0xc04205966f2b4f12}, {0xbfd5555555555555, 0xbfd9f323ecbf984b},
    {0xbfd5555555555556, 0xbfd9f323ecbf984c}, {0x3fd5555555555555, 0x3fd269621134db92},
    {0x3fd5555555555556, 0x3fd269621134db93}, {0x3fd0000000000000, 0x3fcc8ff7c79a9a22},
    {0x3fc8000000000000, 0x3fc5ff3070a793d4}, {0x4024000000000000, 0x40032ee3b77f374c},
    {0x4330000000000000, 0x404205966f2b4f12}, {0x4340000000000001, 0x40425e4f7b2737fa},
    {0x42c3919260831ef2, 0x403f649933b5bf9e}, {0x4071071dfd06f9f6, 0x401671c428d3d019},
    {0x3d9f674af5b67e6e, 0x3d9f674af5b60328}, {0x43af459da080c6a5, 0x4044c86ca8d9c68b},
    {0x432140917fd39898, 0x4041b682868e5693}, {0x3da0e2e956a68b41, 0x3da0e2e956a643f7},
    {0x401f555b16d1b5ac, 0x40016da3b8aba4e3}, {0x404f161945b61df2, 0x4010955f4f9b0f81},
    {0x40928287c832652e, 0x401c4fe78e2160ea}, {0x4035c8d9de0d0fc5, 0x4009023831d37a78},
    {0xbed04fcb5c7fe058, 0xbed04fcd70a4d02c}, {0xbf661e27c65fb8a2, 0xbf6625d0176b9d5e},
    {0xbfdccabeb1d117b7, 0xbfe31f9cd6b4fd31}, {0xbec19232a9fd1ce9, 0xbec19233debb7192},
    {0xbf4c8497c277af32, 0xbf4c87c581371a36}, {0xbfce5e725d09dd29, 0xbfd1555a41a4d97f},
    {0xbf379b867c55dde1, 0xbf379c9d35cbe576}, {0xbf5e1e19f20f678d, 0xbf5e25324f3a112e},
    {0xbf0b77eea6523995, 0xbf0b781dcf0699c4}, {0xbfa2d7f402f6f33d, 0xbfa332f6928846ac},
    {0x7f3ffffffffff000, 0x4085f143c6bd09cc}, {0x7fefffffffffffff, 0x40862e42fefa39ef},
    {0x7fe0000000000000, 0x408628b76e3a7b61}, {0x3fb0000000000000, 0x3faf0a30c01162a6},
    {0x3fafffffffffffff, 0x3faf0a30c01162a5}, {0x3fb0000000000001, 0x3faf0a30c01162a8},
    {0xbfc8000000000000, 0xbfca93ed3c8ad9e4}, {0xbfc8000000000001, 0xbfca93ed3c8ad9e5},
    {0xbfc7ffffffffffff, 0xbfca93ed3c8ad9e2}, {0x3fdc000000000000, 0x3fd739d7f6bbd006},
    {0x3fe0000000000000, 0x3fd9f323ecbf984b}, {0x3fdfffffffffffff, 0x3fd9f323ecbf984b},
    {0xbfd0000000000000, 0xbfd269621134db93}, {0xbfd0000000000001, 0xbfd269621134db94},
};

TEST(Log1pFloat, Points) {
  expect_points<log1p_s<tier::ha>>(log1p_s_ha_points);
  expect_points<log1p_s<tier::la>>(log1p_s_la_points);
  expect_points<log1p_s<tier::ep>>(log1p_s_ep_points);
}

TEST(Log1pDouble, Points) {
  expect_points<log1p_d<tier::ha>>(log1p_d_ha_points);
  expect_points<log1p_d<tier::la>>(log1p_d_la_points);
  expect_points<log1p_d<tier::ep>>(log1p_d_ep_points);
  expect_points<log1p_d_nolut<tier::la>>(log1p_d_nolut_points);
  expect_points<log1p_d_nolut<tier::ep>>(log1p_d_nolut_points);
}

template <typename Body>
class Log1p : public ::testing::Test {};
using bodies =
    ::testing::Types<log1p_s<tier::ha>, log1p_s<tier::la>, log1p_s<tier::ep>, log1p_d<tier::ha>,
                     log1p_d<tier::la>, log1p_d<tier::ep>, log1p_d_nolut<tier::ha>,
                     log1p_d_nolut<tier::la>, log1p_d_nolut<tier::ep>>;
TYPED_TEST_SUITE(Log1p, bodies);

TYPED_TEST(Log1p, Rare) {
  if constexpr (sizeof(typename TypeParam::input_type) == sizeof(float))
    expect_rare_points<TypeParam>(log1p_s_rare_points);
  else
    expect_rare_points<TypeParam>(log1p_d_rare_points);
}

TYPED_TEST(Log1p, Specials) {
  using T = typename TypeParam::input_type;
  using U = part_of<T>;
  using n = named<U>;
  const U minus_one = n::one | n::sign;
  expect_v11<TypeParam>(0, 0, none);
  expect_v11<TypeParam>(n::sign, n::sign, none);
  expect_v11<TypeParam>(minus_one, n::inf | n::sign, pole);
  for (const U x : {U(minus_one + 1), U(minus_one + (minus_one >> 9)), U(n::largest | n::sign),
                    U(n::inf | n::sign)})
    expect_v11<TypeParam>(x, n::nan, domain);
  expect_v11<TypeParam>(n::inf, n::inf, none);
  expect_quiet_nans<TypeParam>();
}

/// Of denormals and the smallest normal numbers the result is the argument, sign included.
TYPED_TEST(Log1p, TinyArguments) {
  using U = part_of<typename TypeParam::input_type>;
  using n = named<U>;
  for (const U x : {U(1), U(2), U(n::smallest_normal - 1), n::smallest_normal,
                    U(n::smallest_normal + 1), U(4 * n::smallest_normal)}) {
    expect_v11<TypeParam>(x, x, none);
    expect_v11<TypeParam>(x | n::sign, x | n::sign, none);
  }
}

/// ln(1 + x) for |x| < 1/2 by the series of 2·artanh(x/(2 + x)).
quad log1p_by_series(double x) {
  const quad z = static_cast<quad>(x) / (2 + static_cast<quad>(x));
  quad term = 2 * z, sum = 0;
  for (int k = 1; k < 200; k += 2, term *= z * z) sum += term / k;
  return sum;
}

/// The polynomials of `ha` without a table are this project's own: held to 0.7 ulp.
TEST(Log1pDouble, ErrorWithoutTableHa) {
  pattern_source<std::uint64_t> source(31);
  double largest = 0;
  for (int i = 0; i < 20'000; ++i) {
    const double u = std::ldexp(static_cast<double>(source.any() >> 11), -53);
    const double x = (u - 0.5) * std::ldexp(1.0, -static_cast<int>(source.below(12)));
    double y = 0;
    EXPECT_EQ(log1p_d_nolut<tier::ha>::call(&x, &y), 0u);
    largest = std::max(largest, ulps(y, log1p_by_series(x)));
  }
  EXPECT_LT(largest, 0.7);
  EXPECT_GT(largest, 0.4);
}

TEST(Log1pFloat, MainPath) {
  expect_main_path_between<log1p_s<tier::ha>>(0xbf7fffff, 0x7a800000);
  expect_main_path_between<log1p_s<tier::la>>(0xbf7fffff, 0x7effffff);
  expect_main_path_between<log1p_s<tier::ep>>(0xbf7fffff, 0x7effffff);
}

TEST(Log1pDouble, MainPath) {
  const std::uint64_t first = 0xbfefffffffffffff;
  expect_main_path_between<log1p_d<tier::ha>>(first, 0x7f3ffffffffff000);
  expect_main_path_between<log1p_d<tier::la>>(first, 0x7f3ffffffffff000);
  expect_main_path_between<log1p_d<tier::ep>>(first, 0x7f3ffffffffff000);
  expect_main_path_between<log1p_d_nolut<tier::ha>>(first, 0x7fefffffffffffff);
  expect_main_path_between<log1p_d_nolut<tier::la>>(first, 0x7fefffffffffffff);
  expect_main_path_between<log1p_d_nolut<tier::ep>>(first, 0x7fefffffffffffff);
}

}  // namespace
