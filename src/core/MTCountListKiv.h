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
        if (message != answers)
            return;
        // The notifier is the model definition; asking it directly spares a look-up in the
        // registry for each of thousands of lists.
        auto* model = dynamic_cast<CParameterSelectionKiv*>(notifier);
        this->SetItemCount(CurrentCount(model ? model : ModelDefinition(this)), 1);
    }

    MTCount Follows() const { return m_follows; }

private:
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
