#pragma once
// The whole public interface of VelaMediaLib.

#include <VelaMediaLib/time/Attribute.h>
#include <VelaMediaLib/time/LambdaObserverWithoutNotifyDelay.h>
#include <VelaMediaLib/time/MetaDatable.h>
#include <VelaMediaLib/time/MultiObjectObserver.h>
#include <VelaMediaLib/time/NotifyDelay.h>
#include <VelaMediaLib/time/Observable.h>
#include <VelaMediaLib/time/Observer.h>
#include <VelaMediaLib/time/ProjectEditRate.h>
#include <VelaMediaLib/time/Range.h>
#include <VelaMediaLib/time/RationalTime.h>
#include <VelaMediaLib/time/RationalUtil.h>
#include <VelaMediaLib/time/ReadWriteMutex.h>
#include <VelaMediaLib/time/SafeRational.h>
#include <VelaMediaLib/time/ScaledTime.h>
#include <VelaMediaLib/time/ScaledTimeRange.h>
#include <VelaMediaLib/time/SimpleProjectEditRate.h>
#include <VelaMediaLib/time/Subject.h>
#include <VelaMediaLib/time/SubjectWithMutex.h>
#include <VelaMediaLib/time/ThreadSafe.h>
#include <VelaMediaLib/time/TimeConverter.h>
#include <VelaMediaLib/time/TimeUtil.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>
#include <VelaMediaLib/time/VelaTime.h>
