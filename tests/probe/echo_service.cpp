// A small ACE service module for the service-configurator test: three services (EchoOne, EchoTwo,
// EchoThree) made by factories named _make_ and the service name. Each keeps the arguments it was
// initialised with and reports them, space-separated, through info().
#include <ace/ACE.h>
#include <ace/OS_NS_string.h>
#include <ace/Service_Object.h>

#include <string>

namespace {

class EchoService : public ACE_Service_Object {
public:
    int init(int argc, ACE_TCHAR* argv[]) override {
        m_arguments = "initialised";
        for (int i = 0; i < argc; ++i) {
            m_arguments += " ";
            m_arguments += argv[i];
        }
        return 0;
    }
    int fini() override { return 0; }
    int info(ACE_TCHAR** text, size_t length) const override {
        if (*text == nullptr) {
            *text = ACE::strnew(m_arguments.c_str());
        } else {
            ACE_OS::strsncpy(*text, m_arguments.c_str(), length);
        }
        return static_cast<int>(m_arguments.size());
    }

private:
    std::string m_arguments;
};

void destroy(void* service) {
    delete static_cast<EchoService*>(service);
}

ACE_Service_Object* make(ACE_Service_Object_Exterminator* exterminator) {
    if (exterminator != nullptr) {
        *exterminator = &destroy;
    }
    return new EchoService;
}

}  // namespace

extern "C" {
__attribute__((visibility("default"))) ACE_Service_Object* _make_EchoOne(
    ACE_Service_Object_Exterminator* exterminator) {
    return make(exterminator);
}
__attribute__((visibility("default"))) ACE_Service_Object* _make_EchoTwo(
    ACE_Service_Object_Exterminator* exterminator) {
    return make(exterminator);
}
__attribute__((visibility("default"))) ACE_Service_Object* _make_EchoThree(
    ACE_Service_Object_Exterminator* exterminator) {
    return make(exterminator);
}
}
