#ifndef OVO_PRESENT_VIEWER_TRACKER_H
#define OVO_PRESENT_VIEWER_TRACKER_H

namespace ovo {

// Follows how near the game's 3D objects come during a frame and turns the nearest one
// into an eye distance and an eye angle for the next frame. Rendering thread only.
class ViewerTracker {
public:
    explicit ViewerTracker(bool active);

    bool IsEnabled() const { return m_active; }

    // One perspective draw: records the normalized depth of its object's origin when it
    // lies strictly between 0 and 1 and on screen. Both matrices are 16 floats.
    void Observe(const float projection[16], const float modelview[16]);

    // Unprojects the nearest depth of the frame at the screen's centre through the last
    // observed projection, then starts a new frame.
    void EstimateEyes();

    float EyeDistance() const { return m_estimated_distance; }
    float EyeAngle() const { return m_estimated_angle; }

private:
    void RecordDepth();

    float m_depth_min;  // 0: nothing recorded in this frame
    const float* m_current_projection;
    const float* m_current_modelview;
    float m_last_projection[16];
    float m_estimated_distance;
    float m_estimated_angle;  // degrees
    bool m_active;
};

}  // namespace ovo

#endif
