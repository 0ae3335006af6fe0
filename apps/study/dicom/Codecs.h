#ifndef VORL_APPS_STUDY_DICOM_CODECS_H
#define VORL_APPS_STUDY_DICOM_CODECS_H

/// @file
/// The decoders and encoders of the DICOM toolkit.

namespace study {

/// Registers the toolkit's RLE, JPEG and JPEG-LS coders and silences its own messages, once per
/// process; safe to call from several threads. They are unregistered when the process ends.
void RegisterDicomCodecs();

}  // namespace study

#endif
