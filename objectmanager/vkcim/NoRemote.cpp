#include "objectmanager/vkcim/Remote.h"

// Of builds without the libraries for HTTP and XML.
namespace vkcim {

class RemoteServer::Impl {};

RemoteServer::RemoteServer(const RemoteOptions&, const om::Schema&) {
    throw std::runtime_error("--url: this vkcim was built without HTTP");
}

RemoteServer::~RemoteServer() = default;

om::Answer RemoteServer::run(const om::Request&) {
    throw om::LoadError("no server can be asked");
}

} // namespace vkcim
