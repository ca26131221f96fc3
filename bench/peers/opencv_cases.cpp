#include <functional>
#include <opencv2/core.hpp>
#include <opencv2/imgproc.hpp>

#include "core_jobs.h"
#include "peers.h"

/// OpenCV on one thread: dilation by a hard disc and Gaussian blur of the padded mask. Neither colours
/// nor blends.
namespace vorel_bench {
namespace {

constexpr char kOpencv[] = "OpenCV";

/// The sigma whose weight at the radius is one hundredth of the centre's, as in the library.
constexpr double kRadiusPerSigma = 3.0349;

cv::Mat disc(int radius) {
    return cv::getStructuringElement(cv::MORPH_ELLIPSE, {2 * radius + 1, 2 * radius + 1});
}

class OpencvJob : public Job {
  public:
    /// Filters the mask with `margin` pixels around it.
    using Filter = std::function<void(const cv::Mat& mask, cv::Mat& result)>;

    OpencvJob(const Workload* workload, int margin, bool inverted, Filter filter)
        : mFilter(std::move(filter)) {
        cv::setNumThreads(1);
        literal::Mask mask = layerMask(*workload, margin);
        mMask = cv::Mat(mask.height, mask.width, CV_8UC1, mask.bytes.data()).clone();
        if (inverted) cv::bitwise_not(mMask, mMask);
        mResult.create(mMask.size(), CV_8UC1);
    }
    void paint() override { mFilter(mMask, mResult); }

  private:
    cv::Mat mMask;
    cv::Mat mResult;
    Filter mFilter;
};

OpencvJob::Filter dilation(int radius) {
    return [element = disc(radius)](const cv::Mat& mask, cv::Mat& result) {
        cv::dilate(mask, result, element, {-1, -1}, 1, cv::BORDER_CONSTANT, cv::Scalar(0));
    };
}

OpencvJob::Filter blur(int radius) {
    return [radius](const cv::Mat& mask, cv::Mat& result) {
        cv::GaussianBlur(mask, result, {2 * radius + 1, 2 * radius + 1}, radius / kRadiusPerSigma,
                         radius / kRadiusPerSigma, cv::BORDER_CONSTANT);
    };
}

void addFilters(Cases& cases, const Workload& workload, int radius) {
    const std::string place = "/" + workload.name + "/R:" + std::to_string(radius);
    const int64_t pixels = workload.grownPixels(radius);
    for (const bool inside : {false, true}) {
        cases.push_back(caseOf<OpencvJob>((inside ? "stroke/inside" : "stroke/outside") + place, kOpencv,
                                          pixels, &workload, radius, inside, dilation(radius)));
    }
    cases.push_back(caseOf<OpencvJob>("shadow/outer" + place, kOpencv, pixels, &workload, radius, false,
                                      blur(radius)));
}

}  // namespace

void addOpencvLookFilters(Cases& cases, const Workload& workload) {
    const int64_t pixels = workload.grownPixels(kLookMargin);
    const OpencvJob::Filter lookA = [stroke = dilation(4), shadow = blur(8)](const cv::Mat& mask,
                                                                             cv::Mat& result) {
        stroke(mask, result);
        shadow(mask, result);
    };
    const OpencvJob::Filter lookC = [stroke = disc(3), shadow = blur(5)](const cv::Mat& mask,
                                                                         cv::Mat& result) {
        cv::Mat inner;
        cv::dilate(mask, result, stroke);
        cv::erode(mask, inner, stroke);
        cv::subtract(result, inner, result);
        shadow(mask, result);
    };
    cases.push_back(caseOf<OpencvJob>("look/A/" + workload.name, kOpencv, pixels, &workload, kLookMargin,
                                      false, lookA));
    cases.push_back(caseOf<OpencvJob>("look/C/" + workload.name, kOpencv, pixels, &workload, kLookMargin,
                                      false, lookC));
}

void addOpencvCases(Cases& cases) {
    for (const Workload* workload : {&line48(), &title160()}) {
        for (const int radius : kRadii)
            addFilters(cases, *workload, radius);
        addOpencvLookFilters(cases, *workload);
    }
}

}  // namespace vorel_bench
