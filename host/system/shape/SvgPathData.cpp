#include "SvgPathData.h"

#include <cctype>
#include <cmath>
#include <cstdlib>
#include <cstring>

namespace Orbane {

namespace {

constexpr float64 kPi = 3.14159265358979323846;

class Reader
{
public:
    Reader(const char *d, std::vector<SvgPathData::Subpath> &out) : mStart(d), mAt(d), mOut(out) {}

    bool Run(std::string *error)
    {
        SkipSpace();
        while (*mAt) {
            if (!Command()) {
                if (error)
                    *error = "character " + std::to_string(mFailAt - mStart + 1) + ": " + mWhy;
                return false;
            }
            SkipSpace();
        }
        return true;
    }

private:
    using Cubic = SvgPathData::Cubic;

    bool Fail(const char *why)
    {
        mFailAt = mAt, mWhy = why;
        return false;
    }
    void SkipSpace()
    {
        while (std::isspace(static_cast<unsigned char>(*mAt)))
            ++mAt;
    }
    void SkipSeparator()
    {
        SkipSpace();
        if (*mAt == ',') {
            ++mAt;
            SkipSpace();
        }
    }
    bool AtNumber() const
    {
        return std::isdigit(static_cast<unsigned char>(*mAt)) || *mAt == '-' || *mAt == '+' || *mAt == '.';
    }
    bool Number(float64 &v)
    {
        SkipSeparator();
        if (!AtNumber())
            return Fail("expected a number");
        const char *p = mAt;
        if (*p == '-' || *p == '+')
            ++p;
        const char *digits = p;
        while (std::isdigit(static_cast<unsigned char>(*p)))
            ++p;
        if (*p == '.')
            for (++p; std::isdigit(static_cast<unsigned char>(*p));)
                ++p;
        if (p == digits || (p == digits + 1 && *digits == '.'))
            return Fail("expected a number");
        if (*p == 'e' || *p == 'E') {
            const char *e = p + 1;
            if (*e == '-' || *e == '+')
                ++e;
            if (std::isdigit(static_cast<unsigned char>(*e)))
                for (p = e; std::isdigit(static_cast<unsigned char>(*p));)
                    ++p;
        }
        // strtod reads no further than the grammar allows: "1.5.5" is two numbers.
        v = std::strtod(std::string(mAt, p).c_str(), nullptr);
        if (!std::isfinite(v))
            return Fail("number out of range");
        mAt = p;
        return true;
    }
    // An arc flag is one digit, 0 or 1, and may touch what follows.
    bool Flag(bool &f)
    {
        SkipSeparator();
        if (*mAt != '0' && *mAt != '1')
            return Fail("expected an arc flag 0 or 1");
        f = *mAt++ == '1';
        return true;
    }
    bool Point(bool rel, OrbPoint &p)
    {
        if (!Number(p.x) || !Number(p.y))
            return false;
        if (rel)
            p += mPen;
        return true;
    }

    SvgPathData::Subpath &Current()
    {
        if (mOut.empty() || mNeedMove) {
            mOut.push_back({mPen, {}, false});
            mNeedMove = false;
        }
        return mOut.back();
    }
    void Add(const OrbPoint &c1, const OrbPoint &c2, const OrbPoint &end, bool line)
    {
        Current().pieces.push_back(Cubic{c1, c2, end, line});
        mPen = end;
    }
    void Line(const OrbPoint &to)
    {
        Add(mPen, to, to, true);
        mLastCubic = mLastQuad = mPen;
    }

    bool Command()
    {
        char cmd = *mAt;
        if (std::isalpha(static_cast<unsigned char>(cmd))) {
            if (!std::strchr("MmLlHhVvCcSsQqTtAaZz", cmd))
                return Fail("unsupported path command");
            if (!mStarted && cmd != 'M' && cmd != 'm')
                return Fail("a path starts with M or m");
            ++mAt;
        } else if (mLast && AtNumber()) {
            // Repeated coordinates repeat the command; after a move, a line.
            cmd = mLast == 'M' ? 'L' : mLast == 'm' ? 'l' : mLast;
        } else {
            return Fail(mStarted ? "expected a command" : "a path starts with M or m");
        }
        mStarted = true;
        mLast = cmd;
        const bool rel = std::islower(static_cast<unsigned char>(cmd));
        switch (std::toupper(static_cast<unsigned char>(cmd))) {
        case 'M':
            return Move(rel);
        case 'L': {
            OrbPoint p;
            return Point(rel, p) && (Line(p), true);
        }
        case 'H': {
            float64 x;
            return Number(x) && (Line({rel ? mPen.x + x : x, mPen.y}), true);
        }
        case 'V': {
            float64 y;
            return Number(y) && (Line({mPen.x, rel ? mPen.y + y : y}), true);
        }
        case 'C':
        case 'S':
            return CubicCmd(rel, std::toupper(static_cast<unsigned char>(cmd)) == 'S');
        case 'Q':
        case 'T':
            return QuadCmd(rel, std::toupper(static_cast<unsigned char>(cmd)) == 'T');
        case 'A':
            return Arc(rel);
        case 'Z':
            return Close();
        default:
            return Fail("unsupported path command");
        }
    }

    bool Move(bool rel)
    {
        OrbPoint p;
        if (!Point(rel, p))
            return false;
        mPen = mSubStart = mLastCubic = mLastQuad = p;
        mNeedMove = true;
        Current();
        return true;
    }
    bool CubicCmd(bool rel, bool smooth)
    {
        OrbPoint c1 = mPen * 2.0 - mLastCubic, c2, end;
        if (!smooth && !Point(rel, c1))
            return false;
        if (!Point(rel, c2) || !Point(rel, end))
            return false;
        Add(c1, c2, end, false);
        mLastCubic = c2, mLastQuad = end;
        return true;
    }
    bool QuadCmd(bool rel, bool smooth)
    {
        OrbPoint q = mPen * 2.0 - mLastQuad, end;
        if (!smooth && !Point(rel, q))
            return false;
        if (!Point(rel, end))
            return false;
        const OrbPoint from = mPen;
        Add(from + (q - from) * (2.0 / 3.0), end + (q - end) * (2.0 / 3.0), end, false);
        mLastQuad = q, mLastCubic = end;
        return true;
    }
    bool Close()
    {
        if (mOut.empty())
            return Fail("Z before any point");
        SvgPathData::Subpath &sub = Current();
        if (mPen != mSubStart)
            Line(mSubStart);
        sub.closed = true;
        mPen = mLastCubic = mLastQuad = mSubStart;
        mNeedMove = true;
        mLast = 0;
        return true;
    }

    bool Arc(bool rel)
    {
        float64 rx, ry, angle;
        bool large, sweep;
        OrbPoint end;
        if (!Number(rx) || !Number(ry) || !Number(angle) || !Flag(large) || !Flag(sweep) || !Point(rel, end))
            return false;
        ArcTo(std::abs(rx), std::abs(ry), angle * kPi / 180.0, large, sweep, end);
        mLastCubic = mLastQuad = mPen;
        return true;
    }
    // The endpoint-to-centre conversion of the SVG implementation notes,
    // then one cubic per quarter turn at most.
    void ArcTo(float64 rx, float64 ry, float64 phi, bool large, bool sweep, const OrbPoint &end)
    {
        const OrbPoint from = mPen;
        if (from == end)
            return;
        if (rx == 0.0 || ry == 0.0) {
            Line(end);
            return;
        }
        const float64 cp = std::cos(phi), sp = std::sin(phi);
        const OrbPoint h = (from - end) / 2.0;
        const OrbPoint p1(cp * h.x + sp * h.y, -sp * h.x + cp * h.y);
        const float64 lambda = (p1.x * p1.x) / (rx * rx) + (p1.y * p1.y) / (ry * ry);
        if (lambda > 1.0)
            rx *= std::sqrt(lambda), ry *= std::sqrt(lambda);
        const float64 num = rx * rx * ry * ry - rx * rx * p1.y * p1.y - ry * ry * p1.x * p1.x;
        const float64 den = rx * rx * p1.y * p1.y + ry * ry * p1.x * p1.x;
        float64 k = std::sqrt(std::max(0.0, num / den));
        if (large == sweep)
            k = -k;
        const OrbPoint c1(k * rx * p1.y / ry, -k * ry * p1.x / rx);
        const OrbPoint mid = (from + end) / 2.0;
        const OrbPoint centre(cp * c1.x - sp * c1.y + mid.x, sp * c1.x + cp * c1.y + mid.y);
        const float64 a0 = std::atan2((p1.y - c1.y) / ry, (p1.x - c1.x) / rx);
        float64 da = std::atan2((-p1.y - c1.y) / ry, (-p1.x - c1.x) / rx) - a0;
        if (sweep && da < 0)
            da += 2 * kPi;
        else if (!sweep && da > 0)
            da -= 2 * kPi;
        const int pieces = std::max(1, int(std::ceil(std::abs(da) / (kPi / 2) - 1e-9)));
        const float64 step = da / pieces, t = 4.0 / 3.0 * std::tan(step / 4.0);
        auto at = [&](float64 a) {
            const float64 x = rx * std::cos(a), y = ry * std::sin(a);
            return OrbPoint(cp * x - sp * y + centre.x, sp * x + cp * y + centre.y);
        };
        auto deriv = [&](float64 a) {
            const float64 x = -rx * std::sin(a), y = ry * std::cos(a);
            return OrbPoint(cp * x - sp * y, sp * x + cp * y);
        };
        for (int i = 0; i < pieces; ++i) {
            const float64 s = a0 + i * step, e = s + step;
            const OrbPoint pe = i == pieces - 1 ? end : at(e);
            Add(mPen + deriv(s) * t, pe - deriv(e) * t, pe, false);
        }
    }

    const char *mStart, *mAt, *mFailAt = nullptr;
    const char *mWhy = "";
    std::vector<SvgPathData::Subpath> &mOut;
    OrbPoint mPen, mSubStart, mLastCubic, mLastQuad;
    char mLast = 0;
    bool mNeedMove = true;
    bool mStarted = false;
};

} // namespace

bool SvgPathData::Parse(const char *d, std::vector<Subpath> &out, std::string *error)
{
    std::vector<Subpath> read;
    if (!d || !Reader(d, read).Run(error))
        return false;
    out.clear();
    for (Subpath &sub : read)
        if (!sub.pieces.empty())
            out.push_back(std::move(sub));
    return true;
}

} // namespace Orbane
