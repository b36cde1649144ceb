#include "controls/Classes.h"

#include <algorithm>
#include <array>

#include "controls/datalist/DataList.h"
#include "controls/fileview/FileView.h"
#include "controls/folderview/FolderView.h"
#include "controls/link/Link.h"
#include "controls/scorecard/ScoreCard.h"
#include "controls/splitter/Splitter.h"
#include "frame/Text.h"

namespace tessel::controls {

namespace {

template <class C>
constexpr frame::ControlClass classOf{
    &C::table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<C>(host); }};

constexpr std::array classes = {classOf<DataList>,  classOf<FileView>,  classOf<FolderView>, classOf<Link>,
                                classOf<ScoreCard>, classOf<Splitter>};

}  // namespace

std::span<const frame::ControlClass> ControlClasses() { return classes; }

const frame::ControlClass* FindControlClass(std::string_view name) {
    const auto found = std::find_if(classes.begin(), classes.end(), [&](const frame::ControlClass& controlClass) {
        return frame::EqualsNoCase(controlClass.table->name, name);
    });
    return found != classes.end() ? &*found : nullptr;
}

}  // namespace tessel::controls
