#include <vorl/IO/BinaryDataIO.h>

inline namespace vorl {

bool IBinaryDataIO::WriteFile(const char* fileName, const char* typeName) {
  try {
    BinaryDataOut out(fileName, typeName);
    Write(out);
    return out.Finish();
  } catch (const dStatus&) {
    return false;
  }
}

bool IBinaryDataIO::ReadFile(const char* fileName, const char* typeName) {
  try {
    BinaryDataIn in(fileName, typeName);
    Read(in);
    return true;
  } catch (const dStatus&) {
    return false;
  }
}

}  // namespace vorl
