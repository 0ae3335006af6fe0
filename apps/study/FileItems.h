#ifndef VORL_APPS_STUDY_FILEITEMS_H
#define VORL_APPS_STUDY_FILEITEMS_H

/// @file
/// What the applications' own binary data files are made of, and reading it without trust.

#include <study/Error.h>
#include <vorl/Data/dCoordSys.h>
#include <vorl/IO/BinaryDataIO.h>

#include <cstddef>
#include <string>

namespace study {

/// Texts have fewer characters than that.
inline constexpr std::size_t kLongestText = 4096;

/// The failure of a stream for the user; `content` is what the file should have held, such as
/// "study".
std::string WhatWentWrong(const dStatus& status, const std::string& content);

/// Throws `Error` with the text unless the condition holds.
void Require(bool holds, const char* what);

/// Coordinates are kept as 12 numbers: origin, x axis, y axis, z axis.
void WriteCoordinates(BinaryDataOut& out, const dCoordSys3D& coordinates);
/// Throws `Error` also for a placement that no volume can have (see `PlacementProblem`).
dCoordSys3D ReadCoordinates(BinaryDataIn& in);
bool SameBits(const dCoordSys3D& a, const dCoordSys3D& b);

/// A number; throws `Error` when it is not finite.
double ReadFinite(BinaryDataIn& in);

/// A text without the zero byte that the format keeps behind it; throws `Error` when it is too long
/// or not ended.
std::string ReadText(BinaryDataIn& in);

}  // namespace study

#endif
