// SPDX-FileCopyrightText: The Arbor Lumen authors
// SPDX-License-Identifier: Apache-2.0
#include <string>
#include <utility>

#include <gtest/gtest.h>

#include "device_impl.hpp"
#include "sycl/exception.hpp"

namespace {

using sycl::detail::parse_devices;
using type = sycl::info::device_type;

TEST(DeviceList, ListsDevicesInOrder) {
  const auto list = parse_devices("cpu;gpu,vendor=51a7,id=1d30;accelerator,fp64=0,fp16=0");
  ASSERT_EQ(list.size(), 3U);
  EXPECT_EQ(list[0].type, type::cpu);
  EXPECT_FALSE(list[0].vendor);
  EXPECT_FALSE(list[0].id);
  EXPECT_TRUE(list[0].fp64);
  EXPECT_TRUE(list[0].fp16);
  EXPECT_EQ(list[0].sub_devices, 1U);
  EXPECT_EQ(list[0].from, sycl::backend::host);
  EXPECT_EQ(list[1].type, type::gpu);
  EXPECT_EQ(list[1].vendor, 0x51A7U);
  EXPECT_EQ(list[1].id, 0x1D30U);
  EXPECT_EQ(list[2].type, type::accelerator);
  EXPECT_FALSE(list[2].fp64);
  EXPECT_FALSE(list[2].fp16);
}

TEST(DeviceList, KnowsEveryKey) {
  const auto list = parse_devices(
      "gpu,vendor=FFFFFFFF,id=0x0,fp64=1,fp16=1,subdevices=4,backend=stratum,name=A B (c) = d");
  ASSERT_EQ(list.size(), 1U);
  EXPECT_EQ(list[0].vendor, 0xFFFFFFFFU);
  EXPECT_EQ(list[0].id, 0U);
  EXPECT_EQ(list[0].sub_devices, 4U);
  EXPECT_EQ(list[0].from, sycl::backend::stratum);
  EXPECT_EQ(list[0].name, "A B (c) = d");
  EXPECT_EQ(parse_devices("cpu,backend=opencl")[0].from, sycl::backend::opencl);
  EXPECT_EQ(parse_devices("cpu,backend=host")[0].from, sycl::backend::host);
}

TEST(DeviceList, WhatIsMalformedIsRefusedByName) {
  const std::pair<const char*, const char*> cases[] = {
      {"", ""},
      {"cpu;", ""},
      {";cpu", ""},
      {"fpga", "fpga"},
      {"CPU", "CPU"},
      {" cpu", " cpu"},
      {"cpu,", ""},
      {"cpu,fp64", "fp64"},
      {"cpu,fp64=", "fp64="},
      {"cpu,fp64=2", "fp64=2"},
      {"cpu,fp16=yes", "fp16=yes"},
      {"gpu,vendor=", "vendor="},
      {"gpu,vendor=51g7", "vendor=51g7"},
      {"gpu,vendor=0x", "vendor=0x"},
      {"gpu,vendor=100000000", "vendor=100000000"},
      {"gpu,id=-1", "id=-1"},
      {"gpu,id= 1", "id= 1"},
      {"gpu,subdevices=0", "subdevices=0"},
      {"gpu,subdevices=2x", "subdevices=2x"},
      {"gpu,subdevices=100000", "subdevices=100000"},
      {"gpu,backend=metal", "backend=metal"},
      {"gpu,name=", "name="},
      {"gpu,colour=red", "colour=red"},
      {"gpu,=1", "=1"},
      {"gpu,fp64=0,fp64=1", "fp64=1"},
      {"cpu gpu", "cpu gpu"}};
  for (const auto& [text, culprit] : cases) {
    try {
      parse_devices(text);
      ADD_FAILURE() << "accepted: " << text;
    } catch (const sycl::exception& e) {
      EXPECT_EQ(e.code(), sycl::errc::runtime);
      EXPECT_NE(std::string(e.what()).find("'" + std::string(culprit) + "'"), std::string::npos)
          << e.what();
      EXPECT_NE(std::string(e.what()).find("LUMEN_SYCL_DEVICES"), std::string::npos);
    }
  }
}

}  // namespace
