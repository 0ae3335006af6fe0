#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dcrledrg.h>
#include <dcmtk/dcmdata/dcrleerg.h>
#include <dcmtk/dcmjpeg/djdecode.h>
#include <dcmtk/dcmjpeg/djencode.h>
#include <dcmtk/dcmjpls/djdecode.h>
#include <dcmtk/dcmjpls/djencode.h>
#include <dcmtk/oflog/oflog.h>
#include <study/dicom/Codecs.h>

namespace study {
namespace {

class Registration {
 public:
  Registration() {
    // Every failure reaches the user once, as our own message.
    OFLog::configure(OFLogger::OFF_LOG_LEVEL);
    DcmRLEDecoderRegistration::registerCodecs();
    DJDecoderRegistration::registerCodecs();
    DJLSDecoderRegistration::registerCodecs();
    DcmRLEEncoderRegistration::registerCodecs();
    DJEncoderRegistration::registerCodecs();
    DJLSEncoderRegistration::registerCodecs();
  }
  ~Registration() {
    DJLSEncoderRegistration::cleanup();
    DJEncoderRegistration::cleanup();
    DcmRLEEncoderRegistration::cleanup();
    DJLSDecoderRegistration::cleanup();
    DJDecoderRegistration::cleanup();
    DcmRLEDecoderRegistration::cleanup();
  }
  Registration(const Registration&) = delete;
  Registration& operator=(const Registration&) = delete;
};

}  // namespace

void RegisterDicomCodecs() {
  static const Registration registration;
}

}  // namespace study
