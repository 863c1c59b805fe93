// An undefined symbol becomes an element of the kind that its user chooses.
#pragma once

class QWidget;

namespace tessal {

class CTessalDoc;
class UserDialogs;
struct CreationOffer;

/// Asks for the kind and has the views of the document create the element; false when it was skipped.
bool CreateOfferedKind(const CreationOffer& offer, CTessalDoc& document, UserDialogs& dialogs,
                       QWidget* parent);

}  // namespace tessal
