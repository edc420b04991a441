#include "host/screens/sharing/MessageComposer.h"

#include "platform/uikit/UIControls.h"

namespace tavro {

void presentMessageComposer(UIView& screen, std::string_view recipient) {
  constexpr double height = 160;
  const CGSize size = screen.frame().size;
  const auto sheet = makeView<UIView>({0, size.height - height, size.width, height});
  sheet->addSubview(makeLabel("New Message", {16, 12, 200, 24}));
  const auto cancel = makeView<UIButton>({size.width - 96, 8, 80, 32});
  cancel->setTitle(string("Cancel"));
  cancel->setAction([sheet = Weak<UIView>(sheet)] {
    if (const Ref<UIView> shown = sheet.strong()) {
      shown->removeFromSuperview();
    }
  });
  sheet->addSubview(cancel);
  sheet->addSubview(makeLabel("To: " + std::string(recipient), {16, 56, size.width - 32, 24}));
  screen.addSubview(sheet);
}

}  // namespace tavro
