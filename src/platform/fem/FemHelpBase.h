#pragma once

// Help topics are addressed by id (5001 and up).
class CFemHelpBase {
public:
    explicit CFemHelpBase(unsigned long helpId = 0) : m_helpId(helpId) {}
    virtual ~CFemHelpBase() = default;
    void HelpID(unsigned long helpId) { m_helpId = helpId; }
    unsigned long GetHelpID() const { return m_helpId; }

private:
    unsigned long m_helpId;
};
