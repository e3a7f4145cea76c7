#include "Configuration/AnonParam.h"

#include "Fields.h"

namespace Configuration {
namespace {
const char kElement[] = "AnonParam";
}

template <class Self, class Io>
void AnonParam::fields(Self& self, Io& io) {
    io("Tag", self.m_tag);
    io("Value", self.m_value);
    io("Description", self.m_description);
}

AnonParam::AnonParam() = default;
AnonParam::AnonParam(const AnonParam& other) = default;
AnonParam& AnonParam::operator=(const AnonParam& other) = default;
AnonParam::~AnonParam() = default;

bool AnonParam::readVesk(const Vesk::Element& element) {
    return Fields::read(*this, element, kElement, Fields::FailureForm::Failed);
}

Quorvex::auto_ptr<Vesk::Element> AnonParam::writeVesk() const {
    return Fields::write(*this, kElement);
}

bool operator==(const AnonParam& a, const AnonParam& b) {
    return Fields::equal(a, b);
}

}  // namespace Configuration
