#include "window/Instance.h"

#include "host/Sha256.h"

#include <cstdlib>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kBus = "org.freedesktop.DBus";
constexpr const char* kBusPath = "/org/freedesktop/DBus";
constexpr const char* kInterface = "org.freedesktop.Application";
/// That of kApplicationId, as desktops make it.
constexpr const char* kApplicationPath = "/example/pallax/Pallax";
constexpr const char* kWindowPath = "/example/pallax/Pallax/shown";
constexpr const char* kInterfaces = R"(<node><interface name="org.freedesktop.Application">
<method name="Activate"><arg type="a{sv}" direction="in"/></method>
<method name="Open"><arg type="as" direction="in"/><arg type="a{sv}" direction="in"/></method>
<method name="ActivateAction"><arg type="s" direction="in"/><arg type="av" direction="in"/>
<arg type="a{sv}" direction="in"/></method>
</interface></node>)";
/// What a window's name begins with; a digest follows, behind a letter.
constexpr std::string_view kWindowNames = "example.pallax.Pallax.Window.s";
constexpr int kAnswerTime = 5000; ///< in milliseconds, for a window that must come to the front

constexpr guint32 kDoNotQueue = 4; ///< a flag of RequestName
constexpr guint32 kIsOwner = 1;    ///< its answers
constexpr guint32 kExists = 3;

struct Freed {
    void operator()(GVariant* value) const { g_variant_unref(value); }
    void operator()(GDBusNodeInfo* node) const { g_dbus_node_info_unref(node); }
};
using Value = std::unique_ptr<GVariant, Freed>;

/// Null if it fails.
Value call(GDBusConnection* bus, const char* to, const char* path, const char* interface,
           const char* method, GVariant* arguments) {
    return Value(g_dbus_connection_call_sync(bus, to, path, interface, method, arguments, nullptr,
                                             G_DBUS_CALL_FLAGS_NO_AUTO_START, kAnswerTime, nullptr,
                                             nullptr));
}

/// The data that goes with a request of the desktop.
GVariant* platformData(const std::string& token) {
    GVariantBuilder data;
    g_variant_builder_init(&data, G_VARIANT_TYPE_VARDICT);
    for (const char* name : {"desktop-startup-id", "activation-token"}) {
        if (!token.empty()) {
            g_variant_builder_add(&data, "{sv}", name, g_variant_new_string(token.c_str()));
        }
    }
    return g_variant_builder_end(&data);
}

std::string tokenIn(GVariant* data) {
    const char* token = "";
    if (g_variant_lookup(data, "activation-token", "&s", &token) == FALSE) {
        (void)g_variant_lookup(data, "desktop-startup-id", "&s", &token);
    }
    return token;
}

/// The target of an action; "" if it is no text.
std::string targetOf(GVariant* arguments) {
    const Value targets(g_variant_get_child_value(arguments, 1));
    if (g_variant_n_children(targets.get()) == 0) {
        return "";
    }
    const Value boxed(g_variant_get_child_value(targets.get(), 0));
    const Value target(g_variant_get_variant(boxed.get()));
    return g_variant_is_of_type(target.get(), G_VARIANT_TYPE_STRING) != FALSE
               ? g_variant_get_string(target.get(), nullptr)
               : "";
}

void refuse(GDBusMethodInvocation* invocation, const char* why) {
    g_dbus_method_invocation_return_error_literal(invocation, G_DBUS_ERROR,
                                                  G_DBUS_ERROR_INVALID_ARGS, why);
}

} // namespace

gtk::Ref<GDBusConnection> sessionBus() {
    gchar* address = g_dbus_address_get_for_bus_sync(G_BUS_TYPE_SESSION, nullptr, nullptr);
    constexpr auto kClient =
        static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                          G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION);
    gtk::Ref<GDBusConnection> bus(
        address == nullptr
            ? nullptr
            : g_dbus_connection_new_for_address_sync(address, kClient, nullptr, nullptr, nullptr));
    g_free(address);
    return bus;
}

std::string activationToken() {
    for (const char* name : {"XDG_ACTIVATION_TOKEN", "DESKTOP_STARTUP_ID"}) {
        const char* token = std::getenv(name); // NOLINT(concurrency-mt-unsafe)
        if (token != nullptr && *token != '\0') {
            return token;
        }
    }
    return "";
}

struct Instance::Call {
    std::string_view path;
    std::string_view method;
    GVariant* arguments;
    GDBusMethodInvocation* invocation;

    std::string token() const {
        const Value data(g_variant_get_child_value(arguments, g_variant_n_children(arguments) - 1));
        return tokenIn(data.get());
    }
    void done() const { g_dbus_method_invocation_return_value(invocation, nullptr); }
};

Instance::Instance(GDBusConnection* bus)
    : _bus(bus != nullptr ? gtk::shared(bus) : gtk::Ref<GDBusConnection>()) {
    if (_bus) {
        exportObject(kApplicationPath);
        exportObject(kWindowPath);
    }
}

Instance::~Instance() {
    if (!_bus) {
        return;
    }
    endServing();
    for (const guint object : _objects) {
        (void)g_dbus_connection_unregister_object(_bus.get(), object);
    }
    (void)g_dbus_connection_flush_sync(_bus.get(), nullptr, nullptr);
}

const GDBusInterfaceVTable& Instance::table() {
    static const GDBusInterfaceVTable kTable{
        .method_call =
            [](GDBusConnection* /*bus*/, const gchar* /*sender*/, const gchar* path,
               const gchar* /*interface*/, const gchar* method, GVariant* arguments,
               GDBusMethodInvocation* invocation, gpointer self) {
                static_cast<Instance*>(self)->answer({path, method, arguments, invocation});
            },
        .get_property = nullptr,
        .set_property = nullptr,
        .padding = {}};
    return kTable;
}

void Instance::exportObject(const char* path) {
    static const std::unique_ptr<GDBusNodeInfo, Freed> node(
        g_dbus_node_info_new_for_xml(kInterfaces, nullptr));
    _objects.push_back(g_dbus_connection_register_object(_bus.get(), path, node->interfaces[0],
                                                         &table(), this, nullptr, nullptr));
}

/// The answer of the bus; 0 if there is none.
guint32 Instance::requestName(const std::string& name, guint32 flags) {
    const Value answer = call(_bus.get(), kBus, kBusPath, kBus, "RequestName",
                              g_variant_new("(su)", name.c_str(), flags));
    guint32 result = 0;
    if (answer) {
        g_variant_get(answer.get(), "(u)", &result);
    }
    return result;
}

void Instance::releaseName(const std::string& name) {
    (void)call(_bus.get(), kBus, kBusPath, kBus, "ReleaseName", g_variant_new("(s)", name.c_str()));
}

bool Instance::present(const std::string& windowName, const std::string& token) {
    return call(_bus.get(), windowName.c_str(), kWindowPath, kInterface, "Activate",
                g_variant_new("(@a{sv})", platformData(token))) != nullptr;
}

bool Instance::claim(const std::string& key, const std::string& token) {
    if (!_bus) {
        return true;
    }
    const std::string name =
        std::string(kWindowNames) + Sha256().add(std::string_view(key)).finish();
    const guint32 answer = requestName(name, kDoNotQueue);
    if (answer == kExists && present(name, token)) {
        return false;
    }
    // A window that does not answer is ending, so that its name may have become free.
    if (answer == kIsOwner || (answer == kExists && requestName(name, kDoNotQueue) == kIsOwner)) {
        _windowName = name;
    }
    return true;
}

void Instance::giveUpClaim() {
    if (const std::string name = std::exchange(_windowName, ""); !name.empty()) {
        releaseName(name);
    }
}

void Instance::serve(Requests requests) {
    _requests = std::move(requests);
    if (_bus) {
        (void)requestName(kApplicationId, 0);
    }
}

void Instance::endServing() {
    if (!_bus) {
        return;
    }
    giveUpClaim();
    releaseName(kApplicationId);
    _requests.present = nullptr;
    while (g_main_context_iteration(nullptr, FALSE) != FALSE) {
    }
    _requests = {};
}

void Instance::answer(const Call& call) {
    if (!_requests.open) {
        return refuse(call.invocation, "The window is not ready.");
    }
    if (call.path == kWindowPath && call.method == "Activate") {
        if (!_requests.present) {
            return refuse(call.invocation, "The window is ending.");
        }
        _requests.present(call.token());
        return call.done();
    }
    if (call.path == kWindowPath) {
        return refuse(call.invocation, "A window can only be activated.");
    }
    if (call.method == "Open") {
        return answerOpen(call);
    }
    if (call.method == "ActivateAction") {
        return answerAction(call);
    }
    _requests.open({}, call.token());
    call.done();
}

void Instance::answerOpen(const Call& call) {
    const Value addresses(g_variant_get_child_value(call.arguments, 0));
    for (gsize index = 0; index < g_variant_n_children(addresses.get()); ++index) {
        const char* address = nullptr;
        g_variant_get_child(addresses.get(), index, "&s", &address);
        const gtk::Ref<GFile> file(g_file_new_for_uri(address));
        gchar* path = g_file_get_path(file.get());
        if (path == nullptr) {
            return refuse(call.invocation, "This is not a file of this machine.");
        }
        _requests.open({path}, call.token());
        g_free(path);
    }
    call.done();
}

/// Brings the window with this name, of whichever process, to the front.
void Instance::showWindow(const std::string& name, const std::string& token) {
    if (name == _windowName) {
        if (_requests.present) {
            _requests.present(token);
        }
    } else if (name.starts_with(kWindowNames) && g_dbus_is_name(name.c_str()) != FALSE) {
        g_dbus_connection_call(_bus.get(), name.c_str(), kWindowPath, kInterface, "Activate",
                               g_variant_new("(@a{sv})", platformData(token)), nullptr,
                               G_DBUS_CALL_FLAGS_NO_AUTO_START, kAnswerTime, nullptr, nullptr,
                               nullptr);
    }
}

/// The actions of the desktop entry, and the one that a notice of an alarm has.
void Instance::answerAction(const Call& call) {
    const char* name = nullptr;
    g_variant_get_child(call.arguments, 0, "&s", &name);
    const std::string_view action = name;
    if (action == kShowAction) {
        showWindow(targetOf(call.arguments), call.token());
    } else if (action == "modem" || action == "demo") {
        _requests.open({name}, call.token());
    } else {
        return refuse(call.invocation, "There is no such action.");
    }
    call.done();
}

} // namespace pallax
