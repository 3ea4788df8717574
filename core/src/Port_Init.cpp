// The initialiser classes: one user count per service.
#include "Port_Init.h"

namespace {

int g_users[5] = {};

int& Users(Port_Service service)
{
    return g_users[static_cast<int>(service)];
}

} // namespace

int Port_GetServiceUsers(Port_Service service)
{
    return Users(service);
}

Port::FileInit::FileInit() { ++Users(Port_Service::File); }
Port::FileInit::~FileInit() { --Users(Port_Service::File); }

Port::PathListInit::PathListInit() { ++Users(Port_Service::PathList); }
Port::PathListInit::~PathListInit() { --Users(Port_Service::PathList); }

InstanceTableInit::InstanceTableInit() { ++Users(Port_Service::InstanceTable); }
InstanceTableInit::~InstanceTableInit() { --Users(Port_Service::InstanceTable); }

FactoryInit::FactoryInit() { ++Users(Port_Service::Factory); }
FactoryInit::~FactoryInit() { --Users(Port_Service::Factory); }

Port_MsgManInit::Port_MsgManInit() { ++Users(Port_Service::MsgMan); }
Port_MsgManInit::~Port_MsgManInit() { --Users(Port_Service::MsgMan); }
