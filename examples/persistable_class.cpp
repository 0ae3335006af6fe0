// A class of the application's own that can be saved and loaded: it writes its members as items of
// a binary data file, and reads them back in the same order.
#include <vorl/vorl.h>

#include <cstdio>

namespace {

class Measurement : public DataBase, public IBinaryDataIO {
 public:
  static BaseClass* Create() { return new Measurement; }
  static ClassInfo& CI() {
    static ClassInfo& info = BuildClassInfo("Measurement", &DataBase::CI(), &Measurement::Create);
    return info;
  }
  ClassInfo* GetClassInfo() override { return &CI(); }
  void Reset() override { *this = Measurement(); }

  void Write(BinaryDataOut& out) override {
    out.WriteString(name);
    out.WriteF64(lengthMm);
    out.Write(&picture);  // a nested object writes itself
  }
  void Read(BinaryDataIn& in) override {
    Reset();
    in.ReadString(name);
    in.ReadF64(lengthMm);
    in.Read(&picture);
  }

  std::string name;
  double lengthMm = 0;
  dImage picture;
};

constexpr char kFile[] = "persistable_class.bdf";
constexpr char kType[] = "Measurement";

}  // namespace

int main() {
  Measurement measured;
  measured.name = "femur";
  measured.lengthMm = 412.5;
  measured.picture.Init(3, 2, ImageDataType_U16, "G", ImageDataOrder_Pixel, 2);
  measured.picture.Fill(7);
  if (!measured.WriteFile(kFile, kType)) {
    return 1;
  }

  Measurement loaded;
  if (!loaded.ReadFile(kFile, kType)) {
    return 1;
  }
  std::printf("%s: %s, %.1f mm, a picture of %lu x %lu pixels\n", loaded.ClassName(),
              loaded.name.c_str(), loaded.lengthMm, loaded.picture.GetWidth(),
              loaded.picture.GetHeight());
  std::printf("as another type: %s\n", loaded.ReadFile(kFile, "Patient") ? "read" : "refused");
  std::remove(kFile);
}

// Prints:
//   Measurement: femur, 412.5 mm, a picture of 3 x 2 pixels
//   as another type: refused
