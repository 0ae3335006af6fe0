#include <study/Error.h>
#include <study/LoadReport.h>

namespace study {

std::string RefusalText(const RefusedFile& refused) {
  return Quoted(refused.file.string()) + ": " + refused.reason;
}

std::string SeriesText(const SeriesInfo& series) {
  std::string text =
      "series " + (series.number ? std::to_string(*series.number) : "without number");
  if (!series.modality.empty()) {
    text += ", " + series.modality;
  }
  if (!series.description.empty()) {
    text += (series.modality.empty() ? ", " : " ") + Quoted(series.description);
  }
  text += ", " + std::to_string(series.slices) + (series.slices == 1 ? " slice" : " slices");
  text += " of " + std::to_string(series.columns) + " x " + std::to_string(series.rows);
  return text + ", UID " + (series.uid.empty() ? "missing" : series.uid);
}

}  // namespace study
