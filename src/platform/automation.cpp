#include "platform/automation.h"

#include "platform/failure.h"

namespace etq {

AutomationObject::AutomationObject(std::shared_ptr<AutomationServer> server)
    : server_(std::move(server)) {}

AutomationServer& AutomationObject::server() const {
    if (!server_) throw Failure(QStringLiteral("Object variable not set"));
    return *server_;
}

QVariant AutomationObject::call(const QString& member, const QVariantList& args) const {
    return server().invoke(Invoke::Method, member, args);
}

QVariant AutomationObject::get(const QString& member, const QVariantList& args) const {
    return server().invoke(Invoke::Get, member, args);
}

void AutomationObject::set(const QString& member, const QVariant& value) const {
    server().invoke(Invoke::Put, member, {value});
}

namespace {
AutomationObject requireObject(const QVariant& value, const QString& member) {
    AutomationObject object = AutomationObject::fromVariant(value);
    if (object.isNothing())
        throw Failure(QStringLiteral("Object required: %1 gave no object").arg(member));
    return object;
}
}  // namespace

AutomationObject AutomationObject::object(const QString& member, const QVariantList& args) const {
    return requireObject(get(member, args), member);
}

AutomationObject AutomationObject::callObject(const QString& member,
                                              const QVariantList& args) const {
    return requireObject(call(member, args), member);
}

AutomationObject AutomationObject::fromVariant(const QVariant& value) {
    return value.metaType() == QMetaType::fromType<AutomationObject>()
               ? value.value<AutomationObject>()
               : AutomationObject();
}

QVariant AutomationObject::toVariant() const {
    return QVariant::fromValue(*this);
}

void AutomationRegistry::add(std::shared_ptr<AutomationProvider> provider) {
    providers_.prepend(std::move(provider));
}

bool AutomationRegistry::canCreate(const QString& className) const {
    for (const auto& provider : providers_)
        if (provider->provides(className)) return true;
    return false;
}

AutomationObject AutomationRegistry::create(const QString& className,
                                            const QString& program) const {
    for (const auto& provider : providers_)
        if (provider->provides(className)) return provider->create(className);
    throw Failure(
        QStringLiteral(
            "%1 is not available here: no program on this system provides the automation class \"%2\"")
            .arg(program.isEmpty() ? className : program, className));
}

}  // namespace etq
