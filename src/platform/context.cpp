#include "platform/context.h"

#include "platform/automation.h"
#include "platform/browser.h"
#include "platform/captions.h"
#include "platform/glabels_automation.h"
#include "platform/messages.h"
#include "platform/settings_keys.h"

namespace etq {

ConnParams::ConnParams()
    : server(settingDefault(u"Params", u"ConnServer")),
      user(settingDefault(u"Params", u"ConnUID")),
      password(settingDefault(u"Params", u"ConnPWD")),
      database(settingDefault(u"Params", u"ConnDataBase")),
      driver(settingDefault(u"Params", u"ConnDriver")) {}

Context::Context()
    : applicationName(QStringLiteral("Etiquon")),
      addressSeparator(QStringLiteral("\r\n")),
      defaultMessages_(std::make_unique<StderrMessageSink>()),
      defaultPages_(std::make_unique<HeadlessPageViewer>()),
      messages_(defaultMessages_.get()),
      pages_(defaultPages_.get()) {}

Context::~Context() = default;

void Context::setMessages(MessageSink* sink) {
    messages_ = sink ? sink : defaultMessages_.get();
}

void Context::setPages(PageViewer* viewer) {
    pages_ = viewer ? viewer : defaultPages_.get();
}

AutomationRegistry& Context::automation() {
    if (!automation_) {
        automation_ = std::make_unique<AutomationRegistry>();
        automation_->add(std::make_shared<GLabelsProvider>());
    }
    return *automation_;
}

QString Context::caption(int n) const {
    return GetCaption(n, language);
}

}  // namespace etq
