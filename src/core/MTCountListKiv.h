// A list with one item per fraction, per layer or per pair of neighbouring layers, kept in
// step with the model definition.
#pragma once

#include "ParameterSelectionKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

#include <algorithm>

enum class MTCount { Fractions, Layers, LayerPairs };

template <class T>
class CMTCountListKiv : public CZoSEKivListBase<T>, public CFemListener {
public:
    CMTCountListKiv(const CString& title, const CString& sectionName, CZoSEKivBase* parent,
                    MTCount follows)
        : CZoSEKivListBase<T>(title, sectionName, parent), m_follows(follows) {
        CParameterSelectionKiv* model = ModelDefinition(this);
        this->SetItemCount(CurrentCount(model), 1);
        Listen(model);
    }

    void Notify(CFemNotifier* notifier, ENotifyMessage message) override {
        if (message == 0) {
            CFemListener::Notify(notifier, message);
            return;
        }
        const ENotifyMessage answers = m_follows == MTCount::Fractions ? kNotifyFractions : kNotifyLayers;
        if (message == answers)
            this->SetItemCount(CurrentCount(ModelDefinition(this)), 1);
    }

    MTCount Follows() const { return m_follows; }

    // The file's own count is applied, so that nothing it holds is lost, but one that
    // disagrees with the model definition is reported here and by validation.
    void LoadSize(void* h) override {
        CZoSEKivListBase<T>::LoadSize(h);
        if (this->GetSectionNamePattern().empty() ||
            !kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1))
            return;
        const int expected = CurrentCount(ModelDefinition(this));
        if (this->GetItemCount() != expected)
            kivWarn(h, "ZoSEKivListItemCount",
                    FormatString("ZoSEKivListItemCount = %d, but the setup has %s",
                                 this->GetItemCount(), Expectation().c_str()));
    }

    int Validate() override {
        int ok = CZoSEKivListBase<T>::Validate();
        const int count = this->GetItemCount();
        if (count != CurrentCount(ModelDefinition(this))) {
            this->AddError(FormatString("%d item%s, but the setup has %s", count,
                                        count == 1 ? "" : "s", Expectation().c_str()));
            ok = 0;
        }
        return ok;
    }

private:
    // "2 fractions", "3 layers (2 transitions)".
    CString Expectation() const {
        const CParameterSelectionKiv* model = ModelDefinition(this);
        auto counted = [](int n, const char* what) {
            return FormatString("%d %s%s", n, what, n == 1 ? "" : "s");
        };
        switch (m_follows) {
        case MTCount::Fractions:
            return counted(model->NumberOfFractions(), "fraction");
        case MTCount::Layers:
            return counted(model->NumberOfLayers(), "layer");
        case MTCount::LayerPairs:
            return counted(model->NumberOfLayers(), "layer") + " (" +
                   counted(CurrentCount(model), "transition") + ")";
        }
        return "";
    }

    int CurrentCount(const CParameterSelectionKiv* model) const {
        switch (m_follows) {
        case MTCount::Fractions:
            return std::max(model->NumberOfFractions(), 0);
        case MTCount::Layers:
            return std::max(model->NumberOfLayers(), 0);
        case MTCount::LayerPairs:
            return std::max(model->NumberOfLayers() - 1, 0);
        }
        return 0;
    }

    MTCount m_follows;
};
