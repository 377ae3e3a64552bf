#include "MTDredgingItemsKiv.h"

#include "MTDredgingFile.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/DomainKiv.h"
#include "paramfile/ParamFile.h"
#include "projection/ZoMapProjection.h"
#include "setupeditor/KivFields.h"
#include "setupeditor/ZoSEKivListBase.h"

#include <algorithm>
#include <cmath>

namespace {
constexpr unsigned kMsgValuesOutOfRange = 4127;
constexpr unsigned kMsgSumOfWeights = 4128;
const char* const kKey = "MTDredging";
const char* const kWeights = "weights_fraction";
const char* const kItemNumbers = "item_numbers";
const char* const kItemNameKeywords[] = {"item_name_x", "item_name_y", "item_rate_of_dredged_mass",
                                         "item_name_spill"};

int Fractions(const CZoSEKivBase* node) {
    const CParameterSelectionKiv* model = ModelDefinition(node);
    return model ? std::max(model->NumberOfFractions(), 0) : 0;
}

// The domain's projection where there is a mesh, else the host's default.
CString DefaultCoordinateType(const CZoSEKivBase* node) {
    const CDomainKiv* domain = Domain(node);
    if (domain && domain->MeshExist() && !domain->Projection().empty())
        return domain->Projection();
    return CZoMapProjection::IDtoProjectionString(CZoMapProjection::kDefaultId);
}

// Numbered after the dredgers already in the list.
CString DefaultName(const CZoSEKivBase* parent) {
    const auto* list = dynamic_cast<const CZoSEKivListBaseInterface*>(parent);
    return FormatString("Dredger %d", (list ? list->GetItemCount() : 0) + 1);
}
}  // namespace

std::vector<double> EvenWeights(int fractions) {
    if (fractions <= 0)
        return {};
    return std::vector<double>(static_cast<std::size_t>(fractions), 100.0 / fractions);
}

struct DredgerFields {
    using D = CMTDredgingItemsKiv;
    using F = KivField<D>;
    // Written before the weights, in this order.
    static inline const F kFields[] = {
        F::Int("include", &D::m_include, 1).Choices("0 excluded, 1 included").Doc("Whether the dredger takes part in the simulation"),
        F::String("name", &D::m_name, "").Doc("Name of the dredger"),
        F::Int("type", &D::m_type, D::kSpillBottom).Doc("Where the dredger releases its spill"),
        F::Bool("update_dredger", &D::m_updateDredger, true).Doc("Whether the dredger's load is updated as it dredges and spills"),
        F::Double("initial_dredger_mass", &D::m_initialMass, 0.0).Unit(100076).Doc("Mass in the dredger at the start"),
        F::Double("maximum_dredger_mass", &D::m_maximumMass, 1e7).Unit(100076).Doc("Mass the dredger can hold"),
        F::Bool("update_distribution", &D::m_updateDistribution, true).Doc("Whether the split of the dredged mass over the fractions is updated"),
    };
};

CMTDredgingItemsKiv::CMTDredgingItemsKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Dredger %d", "DREDGER_%d", parent) {
    DefaultFields(*this, DredgerFields::kFields);
    m_name = DefaultName(parent);
    m_weights = EvenWeights(Fractions(this));
    m_coordinateType = DefaultCoordinateType(this);
    m_file = new CMTDredgingFile(this);
    AddChild(m_file);
    if (GetRoot())
        GetRoot()->RegisterImportantNode(this, kKey);
}

CMTDredgingItemsKiv::~CMTDredgingItemsKiv() {
    // Every dredger registers under the same key; the key goes only with the one it names.
    if (GetRoot() && GetRoot()->GetImportantNode(kKey) == this)
        GetRoot()->UnregisterImportantNode(kKey);
}

double CMTDredgingItemsKiv::WeightFraction(int index) const {
    if (index < 1 || index > static_cast<int>(m_weights.size()))
        return 0.0;
    return m_weights[static_cast<std::size_t>(index - 1)];
}

void CMTDredgingItemsKiv::WeightFraction(int index, double weight) {
    if (index >= 1 && index <= static_cast<int>(m_weights.size()))
        m_weights[static_cast<std::size_t>(index - 1)] = weight;
}

bool CMTDredgingItemsKiv::MatchWeightsToFractions() {
    const int fractions = Fractions(this);
    if (static_cast<int>(m_weights.size()) == fractions)
        return false;
    m_weights = EvenWeights(fractions);
    return true;
}

const char* CMTDredgingItemsKiv::GetDlgRuntimeClass(unsigned code) {
    return code == kDlgRuntimeClassRequest ? "CMTDredgingItemsDlg"
                                           : CZoSEKivBase::GetDlgRuntimeClass(code);
}

void CMTDredgingItemsKiv::WriteData(void* h) {
    WriteFields(h, *this, DredgerFields::kFields);
    MatchWeightsToFractions();
    kivAddKeyword(h, kWeights);
    for (double w : m_weights)
        kivAddDouble(h, w);
    kivPutParam(h, "coordinate_type", m_coordinateType);
    kivPutParamFilename(h, "file_name", m_file->FileName());
    kivPutListParam(h, kItemNumbers, "iiii", m_file->ItemNumber(1), m_file->ItemNumber(2),
                    m_file->ItemNumber(3), m_file->ItemNumber(4));
    for (int i = 0; i < CMTDredgingFile::kItemCount; ++i)
        kivPutParam(h, kItemNameKeywords[i], m_file->ItemName(i + 1));
}

void CMTDredgingItemsKiv::ReadData(void* h) {
    ReadFields(h, *this, DredgerFields::kFields);
    if (m_type < kSpillBottom || m_type > kSpillWaterColumn)
        kivWarn(h, "type",
                FormatString("type = %d is not a known type of spilling (1 to 4); kept as read",
                             m_type));
    ReadWeights(h);
    kivGetParam(h, "coordinate_type", &m_coordinateType, 1, 1);
    ReadDataFile(h);
}

// The weights are taken only whole: a list that is missing, short or holds something that
// is not a number keeps the weights held (an even split for a new dredger).
void CMTDredgingItemsKiv::ReadWeights(void* h) {
    MatchWeightsToFractions();
    const int fractions = static_cast<int>(m_weights.size());
    void* k = kivKeywordByNameNum(h, kWeights, 1);
    if (!k) {
        kivWarn(h, kWeights,
                FormatString("'%s' is missing; the dredged mass is split evenly over %d "
                             "fraction%s",
                             kWeights, fractions, fractions == 1 ? "" : "s"));
        return;
    }
    const int count = kivParamCount(k);
    if (count < fractions) {
        kivWarn(h, kWeights,
                FormatString("'%s' holds %d value%s for %d fractions; the weights are kept",
                             kWeights, count, count == 1 ? "" : "s", fractions));
        return;
    }
    std::vector<double> read(static_cast<std::size_t>(fractions));
    for (int i = 1; i <= fractions; ++i) {
        const auto* p = static_cast<const paramfile::Param*>(kivParamByNum(k, i));
        if (!p || !p->AsDouble(read[static_cast<std::size_t>(i - 1)])) {
            kivParamByNum(k, count);  // the list is refused whole, in this one warning
            kivWarn(h, kWeights,
                    FormatString("'%s' value %d is not a number; the weights are kept",
                                 kWeights, i));
            return;
        }
    }
    // Weights past the fractions are reported with what else reading passed over.
    m_weights = std::move(read);
}

void CMTDredgingItemsKiv::ReadDataFile(void* h) {
    CString fileName = m_file->FileName();
    kivGetParamFilename(h, "file_name", &fileName, 1, 1);
    m_file->FileName(fileName);
    m_file->SetNoItems(CMTDredgingFile::kItemCount);
    if (void* k = kivKeywordByNameNum(h, kItemNumbers, 1)) {
        int n[CMTDredgingFile::kItemCount];
        for (int i = 0; i < CMTDredgingFile::kItemCount; ++i)
            n[i] = m_file->ItemNumber(i + 1);
        kivGetListParam(h, kItemNumbers, 1, "iiii", &n[0], &n[1], &n[2], &n[3]);
        for (int i = 0; i < CMTDredgingFile::kItemCount; ++i)
            m_file->ItemNumber(i + 1, n[i]);
        // More are reported with what else reading passed over.
        if (kivParamCount(k) < CMTDredgingFile::kItemCount)
            kivWarn(h, kItemNumbers,
                    FormatString("'%s' holds %d values where the dredger reads 4 (x, y, rate, "
                                 "spill)",
                                 kItemNumbers, kivParamCount(k)));
    }
    for (int i = 0; i < CMTDredgingFile::kItemCount; ++i) {
        CString name;
        kivGetParam(h, kItemNameKeywords[i], &name, 1, 1);
        m_file->ItemName(i + 1, name);
    }
}

int CMTDredgingItemsKiv::ValidateData() {
    const bool massesOk = m_initialMass >= 0.0 && m_maximumMass > 0.0;
    const bool typeOk = m_type >= kSpillBottom && m_type <= kSpillWaterColumn;
    // What the next save writes: an even split where the fractions changed since.
    std::vector<double> weights = m_weights;
    if (static_cast<int>(weights.size()) != Fractions(this))
        weights = EvenWeights(Fractions(this));
    const bool weightsOk = std::all_of(weights.begin(), weights.end(),
                                       [](double w) { return w >= 0.0 && std::isfinite(w); });
    if (!massesOk || !typeOk || !weightsOk) {
        AddError(kMsgValuesOutOfRange);
        return 0;
    }
    double sum = 0.0;
    for (double w : weights)
        sum += w;
    // Written so that a sum that is not a number fails as well.
    if (!(std::fabs(sum - 100.0) <= kWeightTolerance)) {
        AddError(kMsgSumOfWeights);
        return 0;
    }
    return 1;
}

void CMTDredgingItemsKiv::SetDefault() {
    DefaultFields(*this, DredgerFields::kFields);
    const int n = GetNumberWhatAmI();
    m_name = FormatString("Dredger %d", n > 0 ? n : 1);
    m_weights = EvenWeights(Fractions(this));
    m_coordinateType = DefaultCoordinateType(this);
    m_file->SetDefault();
}

void CMTDredgingItemsKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kDecls[] = {
        {kWeights, KeywordType::DoubleList, "", "Split of the dredged mass over the fractions, one weight a fraction (they sum to 100)", 0, ">= 0"},
        {"coordinate_type", KeywordType::String, "", "Map projection of the dredger's track"},
        {"file_name", KeywordType::FileName, "''", "Time series of the dredger: x, y, rate of dredged mass, spill"},
        {kItemNumbers, KeywordType::IntList, "1, 2, 3, 4", "Items of the file for x, y, rate of dredged mass and spill"},
        {"item_name_x", KeywordType::String, "\"\"", "Name of the file's item for x"},
        {"item_name_y", KeywordType::String, "\"\"", "Name of the file's item for y"},
        {"item_rate_of_dredged_mass", KeywordType::String, "\"\"", "Name of the file's item for the rate of dredged mass"},
        {"item_name_spill", KeywordType::String, "\"\"", "Name of the file's item for the spill"},
    };
    DescribeFields(sink, DredgerFields::kFields);
    sink.Add(kDecls);
}
