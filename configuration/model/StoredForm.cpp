#include "Configuration/StoredForm.h"

#include "Quorvex/InputZMemStream.h"
#include "Quorvex/OutputZMemStream.h"
#include "Vesk/XmlUtils.h"

namespace Configuration {

std::string StoredForm::encode(const Vesk::Element& tree) {
    OutputZMemStream out(kInitialCapacity, kCompressionLevel);
    Vesk::XmlUtils::streamOut(tree, out, Vesk::Ordering(), ACE_CString());
    out.flush();
    return std::string(reinterpret_cast<const char*>(out.data()), out.size());
}

void StoredForm::decode(const unsigned char* data, std::size_t len, Vesk::Element& tree) {
    InputZMemStream in(data, len);
    Vesk::XmlUtils::streamIn(in, tree, ACE_CString());
}

}  // namespace Configuration
