#include <study/FileItems.h>
#include <study/Study.h>

#include <array>
#include <cmath>
#include <cstring>

namespace study {
namespace {

using CoordinateArray = std::array<float, 12>;

CoordinateArray ToArray(const dCoordSys3D& c) {
  return {c.origin.x, c.origin.y, c.origin.z, c.axisX.x, c.axisX.y, c.axisX.z,
          c.axisY.x,  c.axisY.y,  c.axisY.z,  c.axisZ.x, c.axisZ.y, c.axisZ.z};
}

dCoordSys3D FromArray(const CoordinateArray& a) {
  return {dVect3D(a[0], a[1], a[2]), dVect3D(a[3], a[4], a[5]), dVect3D(a[6], a[7], a[8]),
          dVect3D(a[9], a[10], a[11])};
}

}  // namespace

std::string WhatWentWrong(const dStatus& status, const std::string& content) {
  switch (static_cast<long>(status)) {
    case -3:
      return "the file can't be opened";
    case -100:
      return "the disk is full, or the writing failed";
    case -200:
    case -201:
      return "the file ends too early or is damaged";
    case -202:
      return "it is a binary data file, but holds no " + content;
    case -203:
      return "it is no binary data file";
    default:
      return std::string("the file is damaged (") + static_cast<const char*>(status) + ")";
  }
}

void Require(bool holds, const char* what) {
  if (!holds) {
    throw Error(what);
  }
}

void WriteCoordinates(BinaryDataOut& out, const dCoordSys3D& coordinates) {
  const CoordinateArray numbers = ToArray(coordinates);
  out.WriteF32Array(numbers.data(), static_cast<int>(numbers.size()));
}

dCoordSys3D ReadCoordinates(BinaryDataIn& in) {
  CoordinateArray numbers{};
  Require(in.ReadArrayLength() == numbers.size(), "its coordinates are not twelve numbers");
  in.ReadF32Array(numbers.data(), static_cast<int>(numbers.size()));
  const dCoordSys3D coordinates = FromArray(numbers);
  const std::string problem = PlacementProblem(coordinates);
  if (!problem.empty()) {
    throw Error(problem);
  }
  return coordinates;
}

bool SameBits(const dCoordSys3D& a, const dCoordSys3D& b) {
  const CoordinateArray first = ToArray(a);
  const CoordinateArray second = ToArray(b);
  return std::memcmp(first.data(), second.data(), sizeof first) == 0;
}

double ReadFinite(BinaryDataIn& in) {
  double value = 0;
  in.ReadF64(value);
  Require(std::isfinite(value), "a number in it is not finite");
  return value;
}

std::string ReadText(BinaryDataIn& in) {
  const unsigned long size = in.ReadArrayLength();
  Require(size >= 1 && size <= kLongestText, "a text in it has an impossible length");
  std::string text(size, '\0');
  in.ReadU8Array(reinterpret_cast<unsigned char*>(text.data()), static_cast<int>(size));
  Require(text.find('\0') == size - 1, "a text in it is not ended by a zero byte");
  text.pop_back();
  return text;
}

}  // namespace study
