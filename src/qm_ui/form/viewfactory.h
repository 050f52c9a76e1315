// From dialog models to their windows: which view a model gets, and how it is run.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_ui/form/formview.h"

#include <QSize>

#include <functional>
#include <map>
#include <memory>
#include <typeindex>

/// Where a window comes up. The number is that of the host's rule.
enum class PLACEMENT {
    Free = 0,  // where the window system puts it
    Beside = 3 // beside the window that asks, as far as the screen allows: it explains that one
};

/// How a view fills its window.
struct T_VIEW {
    TextFn title{};
    /// Adds fields and bindings. Null for a model that has a window of its own (see window).
    std::function<void(CFormView& form, zql::frx::MDialog& model)> build{};
    /// The text of the accepting button, asked for after each change; empty: "OK". A window that
    /// only shows has none.
    std::function<std::string(const zql::frx::MDialog& model)> accept{};
    bool showsOnly = false; // one button, "Close"
    QSize size{};           // wanted; empty: what the form needs
    PLACEMENT placement = PLACEMENT::Free;
    /// Asked before the window closes without accepting; false: it stays open. Empty: it closes.
    std::function<bool(zql::frx::MDialog& model)> closes{};
};

/// State: the views that were registered. Belongs to the application; dialogs ask for it.
class CViewFactory {
public:
    /// The view of a model class. The model that is handed to `build` is of that class.
    template <class MODEL>
    void Register(TextFn title, std::function<void(CFormView&, MODEL&)> build, T_VIEW more = {})
    {
        more.title = std::move(title);
        more.build = [build = std::move(build)](CFormView& form, zql::frx::MDialog& model) {
            build(form, dynamic_cast<MODEL&>(model));
        };
        m_views[typeid(MODEL)] = std::move(more);
    }
    /// Null: no view is registered for this model.
    const T_VIEW* Find(const zql::frx::MDialog& model) const;

private:
    std::map<std::type_index, T_VIEW> m_views;
};
