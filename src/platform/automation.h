#pragma once

// Late-bound automation, the way label software programs are driven: an object is created by
// its class name ("NiceLabel.Application"), and its members are reached by name at run time,
// with QVariant arguments and results. A member whose value is itself an object (a document, a
// collection) gives an AutomationObject inside the QVariant.
//
// Which class names can be created is decided by the providers registered in a registry; the
// registry belongs to a run's Context, so tests and runs side by side each have their own. A
// provider's object reports a failing call by throwing (Failure, with a description the user
// can act on); the caller decides how to tell it.

#include <QList>
#include <QString>
#include <QVariant>
#include <memory>

namespace etq {

// How a member is reached: a method call, a property read, a property write (whose value is
// the last argument).
enum class Invoke { Method, Get, Put };

// What a provider implements for each object it makes.
class AutomationServer {
  public:
    virtual ~AutomationServer() = default;
    virtual QVariant invoke(Invoke how, const QString& member, const QVariantList& args) = 0;
};

// A reference to an automation object, shared like the references of the original language:
// the object lives while a reference does. An empty reference is Nothing.
class AutomationObject {
  public:
    AutomationObject() = default;
    explicit AutomationObject(std::shared_ptr<AutomationServer> server);

    bool isNothing() const { return !server_; }
    // Drops this reference (Set x = Nothing).
    void release() { server_.reset(); }

    QVariant call(const QString& member, const QVariantList& args = {}) const;
    QVariant get(const QString& member, const QVariantList& args = {}) const;
    void set(const QString& member, const QVariant& value) const;
    // The object a property gives (Set doc = app.ActiveDocument) or a method returns; throws
    // Failure "Object required" when the value is no object.
    AutomationObject object(const QString& member, const QVariantList& args = {}) const;
    AutomationObject callObject(const QString& member, const QVariantList& args = {}) const;

    // The object inside a value; Nothing when the value holds none.
    static AutomationObject fromVariant(const QVariant& value);
    QVariant toVariant() const;

  private:
    AutomationServer& server() const;
    std::shared_ptr<AutomationServer> server_;
};

// Makes the objects of some class names.
class AutomationProvider {
  public:
    virtual ~AutomationProvider() = default;
    virtual bool provides(const QString& className) const = 0;
    // Throws Failure when the object cannot be made after all (its program is missing, say).
    virtual AutomationObject create(const QString& className) = 0;
};

// The class names a run can create: the providers registered, the last one registered asked
// first.
class AutomationRegistry {
  public:
    void add(std::shared_ptr<AutomationProvider> provider);
    bool canCreate(const QString& className) const;
    // A new object of the class. A class no provider makes throws Failure naming `program`
    // (the class name when none is given) and saying that it is not available here.
    AutomationObject create(const QString& className, const QString& program = {}) const;

  private:
    QList<std::shared_ptr<AutomationProvider>> providers_;
};

}  // namespace etq

Q_DECLARE_METATYPE(etq::AutomationObject)
