#ifndef VORL_APPS_STUDY_PICTURES_H
#define VORL_APPS_STUDY_PICTURES_H

/// @file
/// Images as picture files.

#include <vorl/Data/dImage.h>

#include <filesystem>

namespace study {

/// Writes an image as PNG or BMP, by the extension of `path` (".png" or ".bmp", in any case).
///
/// Images have 8 bits and one channel (grey), or the channel sequence "BGR" in pixel order
/// (colour); PNG also takes unsigned 16-bit grey. Rows may have any alignment. The file appears
/// only when it is complete; an earlier one of this name is replaced. Throws `Error` for another
/// extension, for an image that cannot be written so, and when the writing fails (a full disk, for
/// instance).
void SavePicture(const dImage& image, const std::filesystem::path& path);

/// The same with the kind chosen by name rather than by extension.
void SavePng(const dImage& image, const std::filesystem::path& path);
/// BMP also takes images of 1 bit, and "BGRA". `ascending`: the colour table of grey images runs
/// from black to white, else from white to black.
void SaveBmp(const dImage& image, const std::filesystem::path& path, bool ascending = true);

/// Reads a PNG of up to 8 bits per sample: grey, "BGR", or "BGRA" where something is transparent.
/// Colour spaces are left out of account. Throws `Error` ("can't read 'name': ...").
void LoadPng(const std::filesystem::path& path, dImage& image);
/// Reads a BMP (see `opDIB2Ima`). Throws `Error` ("can't read 'name': ...").
void LoadBmp(const std::filesystem::path& path, dImage& image);

}  // namespace study

#endif
