// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "platform/forms/Animation.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "platform/forms/Undisturbed.h"

namespace yearend {

/// A screen of a bulk job: bars that tell how far it is, and the clip that plays meanwhile.
class JobScreen : public forms::Form {
    Q_OBJECT
public:
    forms::Animation* Animation1;

    /// Bars stand under each other and are counted from 0.
    forms::ProgressBar& bar(int number) { return *bars_[static_cast<std::size_t>(number)]; }
    /// Begins to play the clip that lies beside the component. Fails when it is missing or broken.
    void playClip();
    /// Runs the job; meanwhile no key and no click reaches any window.
    void work(const std::function<void()>& job);
    /// Gives the windows their turn, while the job runs.
    void serve() {
        if (undisturbed_) undisturbed_->serve();
    }

protected:
    JobScreen(const QString& name, const QString& caption);
    struct Bar {
        QString labelName;
        QString label;
        QString name;
    };
    /// @param above  what stands between the heading and the bars; null for nothing
    void layOut(QWidget* heading, QLayout* above, const std::vector<Bar>& bars,
                std::initializer_list<forms::Button*> buttons);

private:
    std::vector<forms::ProgressBar*> bars_;
    forms::Undisturbed* undisturbed_ = nullptr;  ///< while the job runs
};

}  // namespace yearend
