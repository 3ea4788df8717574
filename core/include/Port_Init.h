// The initialiser classes of the portability library.
//
// Each object holds the library's hold on one service for as long as it lives:
// constructing it adds a user to the service, destroying it removes that user.
// A library that uses the services keeps one object of each as a static object
// of library lifetime. Port_GetServiceUsers tells how many hold a service now.
#pragma once

#include "Tavo_CoreApi.h"

enum class Port_Service {
    File,
    PathList,
    InstanceTable,
    Factory,
    MsgMan
};

TAVO_CORE_API int Port_GetServiceUsers(Port_Service service);

namespace Port {

class TAVO_CORE_API FileInit {
public:
    FileInit();
    ~FileInit();
    FileInit(const FileInit&) = delete;
    FileInit& operator=(const FileInit&) = delete;
};

class TAVO_CORE_API PathListInit {
public:
    PathListInit();
    ~PathListInit();
    PathListInit(const PathListInit&) = delete;
    PathListInit& operator=(const PathListInit&) = delete;
};

} // namespace Port

class TAVO_CORE_API InstanceTableInit {
public:
    InstanceTableInit();
    ~InstanceTableInit();
    InstanceTableInit(const InstanceTableInit&) = delete;
    InstanceTableInit& operator=(const InstanceTableInit&) = delete;
};

class TAVO_CORE_API FactoryInit {
public:
    FactoryInit();
    ~FactoryInit();
    FactoryInit(const FactoryInit&) = delete;
    FactoryInit& operator=(const FactoryInit&) = delete;
};

class TAVO_CORE_API Port_MsgManInit {
public:
    Port_MsgManInit();
    ~Port_MsgManInit();
    Port_MsgManInit(const Port_MsgManInit&) = delete;
    Port_MsgManInit& operator=(const Port_MsgManInit&) = delete;
};
