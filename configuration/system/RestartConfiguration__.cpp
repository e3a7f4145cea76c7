#include "Configuration/RestartConfiguration__.h"

#include "model/Fields.h"

namespace Configuration {
namespace {
const char kElement[] = "Restart";
}

template <class Self, class Io>
void RestartConfiguration__::fields(Self& self, Io& io) {
    io("RestartTimeOfDay", self.m_restartTimeOfDay);
    io("RestartNumberOfDaysBetween", self.m_restartNumberOfDaysBetween);
}

RestartConfiguration__::RestartConfiguration__() = default;
RestartConfiguration__::RestartConfiguration__(const RestartConfiguration__& other) = default;
RestartConfiguration__& RestartConfiguration__::operator=(const RestartConfiguration__& other) =
    default;
RestartConfiguration__::~RestartConfiguration__() = default;

bool RestartConfiguration__::readVesk(const Vesk::Element& element) {
    return Fields::read(*this, element, "RestartConfiguration__",
                        Fields::FailureForm::PartialDefaults);
}

Quorvex::auto_ptr<Vesk::Element> RestartConfiguration__::writeVesk() const {
    return Fields::write(*this, kElement);
}

bool operator==(const RestartConfiguration__& a, const RestartConfiguration__& b) {
    return Fields::equal(a, b);
}

}  // namespace Configuration
