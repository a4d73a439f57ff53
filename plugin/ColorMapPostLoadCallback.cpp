#include "ColorMapPostLoadCallback.h"

#include "Map.h"

namespace Pigmo::ColorMap {

void ColorMapPostLoadCallback::proc(ILoad*) {
    // The picked color itself came with the scene; only the book is read again.
    if (map_->GetParamBlock(0)->GetStr(colorBookFilePath) != nullptr) map_->ReloadColorBook();
    const int selected = map_->GetSelectedIndex();
    if (selected != -1) map_->SetScrollPosition(selected);
    delete this;
}

}  // namespace Pigmo::ColorMap
