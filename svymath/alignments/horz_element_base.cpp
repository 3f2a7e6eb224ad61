#include "svymath/alignments/horz_element_base.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

CHorzAlntElemBase::~CHorzAlntElemBase() = default;

bool CHorzAlntElemBase::getPosNeAtChain(double chainage, double& north, double& east) const {
  double distance = 0.0;
  return chainage2Distance(chainage, distance) && getPosNeAtLength(distance, north, east);
}

bool CHorzAlntElemBase::getPosNeAtChainExtr(double chainage, double& north, double& east) const {
  return getPosNeAtChainAndOffsetExtr(chainage, 0.0, north, east);
}

bool CHorzAlntElemBase::getAzimuthAtChain(double chainage, double& azimuthDeg) const {
  double distance = 0.0;
  return chainage2Distance(chainage, distance) && getAzimuthAtLength(distance, azimuthDeg);
}

bool CHorzAlntElemBase::getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const {
  double distance = 0.0;
  double length = 0.0;
  if (!chainage2Distance(chainage, distance) || !getHLengthInM(length) || std::isnan(distance)) return false;
  if (distance >= 0.0 && distance <= length) return getAzimuthAtLength(distance, azimuthDeg);
  CMathAngle azimuth;
  if (!(distance < 0.0 ? getStartAzimut(azimuth) : getFinalAzimut(azimuth))) return false;
  azimuthDeg = azimuth.getDeg();
  return true;
}

bool CHorzAlntElemBase::getChainageAndOffsetForPos(double north, double east, double& chainage,
                                                   double& offset) const {
  double length = 0.0;
  double off = 0.0;
  double ch = 0.0;
  if (!getLengthAndOffset(north, east, length, off) || !distance2Chainage(length, ch)) return false;
  chainage = ch;
  offset = off;
  return true;
}

// Inside the element: the point at the distance and its tangent. Before the start the start tangent is
// prolonged backwards, after the end the final tangent forwards. The offset is then laid off square to
// that tangent, positive to the right.
bool CHorzAlntElemBase::getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north,
                                                     double& east) const {
  double distance = 0.0;
  double length = 0.0;
  if (!chainage2Distance(chainage, distance) || !getHLengthInM(length) || std::isnan(distance) ||
      std::isnan(offset)) {
    return false;
  }
  C2dPos onLine;
  CMathAngle tangent;
  if (distance >= 0.0 && distance <= length) {
    double azimuthDeg = 0.0;
    if (!getPosNeAtLength(distance, onLine.north(), onLine.east()) || !getAzimuthAtLength(distance, azimuthDeg)) {
      return false;
    }
    tangent.setDeg(azimuthDeg);
  } else {
    C2dPos end;
    const bool before = distance < 0.0;
    const bool ok = before ? getStartPosNe(end.north(), end.east()) && getStartAzimut(tangent)
                           : getFinalPosNe(end.north(), end.east()) && getFinalAzimut(tangent);
    if (!ok) return false;
    tangent.getPosAlong(before ? distance : distance - length, end, onLine);
  }
  tangent.getPosAcross(offset, onLine.north(), onLine.east(), north, east);
  return true;
}

bool CHorzAlntElemBase::getCurvatureAtChainage(double chainage, double& curvature) const {
  double distance = 0.0;
  return chainage2Distance(chainage, distance) && getCurvatureAtLength(distance, curvature);
}

double CHorzAlntElemBase::getNextPosForDeviation(double chainage, double deviation, double& north,
                                                 double& east) const {
  double distance = 0.0;
  if (!chainage2Distance(chainage, distance)) return chainage;
  const double next = distance + getStepForDeviation(distance, deviation);
  double reached = chainage;
  if (getPosNeAtLength(next, north, east)) distance2Chainage(next, reached);
  return reached;
}
