#include "ui/offered_creation.h"

#include "core/document.h"
#include "ui/create_hint.h"
#include "ui/dialogs.h"
#include "ui/text_bytes.h"

namespace tessal {

bool CreateOfferedKind(const CreationOffer& offer, CTessalDoc& document, UserDialogs& dialogs,
                       QWidget* parent) {
  const int choice = dialogs.ChooseKind(parent, ToScreen(offer.symbol), offer.mask);
  const CreateRequest* request = offer.RequestOf(choice);
  if (request == nullptr) return false;
  const CreateHint argument(*request);
  document.UpdateAllViews(nullptr, hint::kCreateElement, &argument);
  return true;
}

}  // namespace tessal
