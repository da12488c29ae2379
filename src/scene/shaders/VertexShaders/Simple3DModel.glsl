// In the space of a model, with its normal.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;

attribute vec3 a_position;
attribute vec3 a_normal;

varying vec3 v_Normal;

void main()
{
	v_Normal = ToWorld(u_ModelTransform, a_normal);
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(a_position, 1.0));
}
